#include "tests/support/audio_fixtures.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <stdexcept>
#include <vorbis/vorbisenc.h>

namespace testing_support
{
namespace
{

void PutU16(Bytes& out, std::uint32_t value)
{
    out.push_back(std::uint8_t(value));
    out.push_back(std::uint8_t(value >> 8));
}

void PutU32(Bytes& out, std::uint32_t value)
{
    PutU16(out, value & 0xFFFF);
    PutU16(out, value >> 16);
}

void Append(Bytes& out, const ogg_page& page)
{
    out.insert(out.end(), page.header, page.header + page.header_len);
    out.insert(out.end(), page.body, page.body + page.body_len);
}

} // namespace

RiffWriter& RiffWriter::Chunk(const char* id, const Bytes& body)
{
    return ChunkClaiming(id, static_cast<std::uint32_t>(body.size()), body);
}

RiffWriter& RiffWriter::ChunkClaiming(const char* id, std::uint32_t claimedSize, const Bytes& body)
{
    chunks_.insert(chunks_.end(), id, id + 4);
    PutU32(chunks_, claimedSize);
    chunks_.insert(chunks_.end(), body.begin(), body.end());
    if (body.size() % 2 != 0)
        chunks_.push_back(0);
    return *this;
}

Bytes RiffWriter::Finish(const char* form) const
{
    Bytes out{'R', 'I', 'F', 'F'};
    PutU32(out, static_cast<std::uint32_t>(4 + chunks_.size()));
    out.insert(out.end(), form, form + 4);
    out.insert(out.end(), chunks_.begin(), chunks_.end());
    return out;
}

Bytes FormatChunkBody(const WaveSpec& fixture)
{
    Bytes body;
    const std::uint32_t blockAlign = fixture.channels * (fixture.bitsPerSample / 8u);
    PutU16(body, fixture.formatTag);
    PutU16(body, fixture.channels);
    PutU32(body, fixture.sampleRate);
    PutU32(body, blockAlign * fixture.sampleRate);
    PutU16(body, blockAlign);
    PutU16(body, fixture.bitsPerSample);
    if (fixture.formatTag != 1)
    {
        PutU16(body, static_cast<std::uint32_t>(fixture.extra.size()));
        body.insert(body.end(), fixture.extra.begin(), fixture.extra.end());
    }
    return body;
}

Bytes PatternBytes(std::size_t size)
{
    Bytes bytes(size);
    for (std::size_t i = 0; i < size; ++i)
        bytes[i] = static_cast<std::uint8_t>(i * 7 + i / 251);
    return bytes;
}

Bytes MakeWave(const WaveSpec& fixture)
{
    return RiffWriter()
        .Chunk("fmt ", FormatChunkBody(fixture))
        .Chunk("data", PatternBytes(fixture.dataBytes))
        .Finish();
}

Bytes MakeWaveOfLength(double seconds)
{
    return MakeWave({.channels = 1,
                     .sampleRate = 1000,
                     .bitsPerSample = 8,
                     .dataBytes = static_cast<std::uint32_t>(std::llround(seconds * 1000.0))});
}

Bytes MakeToneWave(const WaveSpec& format, double seconds, const LevelAt& dbfs)
{
    const int bytes = format.bitsPerSample / 8;
    Bytes data;
    for (std::size_t frame = 0; frame < std::size_t(seconds * format.sampleRate); ++frame)
    {
        const double time = double(frame) / format.sampleRate;
        const double sample = std::pow(10.0, dbfs(time) / 20.0) * std::sin(6264.0 * time);
        const float single = float(sample);
        std::uint64_t word = std::uint64_t(
            std::llround(sample * (std::ldexp(1.0, 8 * bytes - 1) - 1)) + (bytes == 1 ? 128 : 0));
        if (format.formatTag == 3)
            bytes == 4 ? std::memcpy(&word, &single, 4) : std::memcpy(&word, &sample, 8);
        for (int i = 0; i < bytes * format.channels; ++i)
            data.push_back(std::uint8_t(word >> 8 * (i % bytes)));
    }
    WaveSpec sized = format;
    sized.dataBytes = static_cast<std::uint32_t>(data.size());
    return RiffWriter().Chunk("fmt ", FormatChunkBody(sized)).Chunk("data", data).Finish();
}

Bytes EncodeOggVorbis(const OggFixture& fixture, const SampleSource& source)
{
    vorbis_info info;
    vorbis_info_init(&info);
    if (vorbis_encode_init_vbr(&info, fixture.channels, fixture.sampleRate, fixture.quality) != 0)
        throw std::runtime_error("libvorbisenc refused the encoder settings");
    vorbis_comment comment;
    vorbis_comment_init(&comment);
    vorbis_dsp_state dsp;
    vorbis_analysis_init(&dsp, &info);
    vorbis_block block;
    vorbis_block_init(&dsp, &block);
    ogg_stream_state stream;
    ogg_stream_init(&stream, 0x56454B);
    Bytes out;
    ogg_packet headers[3];
    vorbis_analysis_headerout(&dsp, &comment, &headers[0], &headers[1], &headers[2]);
    for (ogg_packet& header : headers)
        ogg_stream_packetin(&stream, &header);
    ogg_page page;
    while (ogg_stream_flush(&stream, &page) != 0)
        Append(out, page);
    for (std::uint64_t written = 0, count = 1; count != 0; written += count)
    {
        count = std::min<std::uint64_t>(fixture.samplesPerChannel - written, 1024);
        float** buffer = count == 0 ? nullptr : vorbis_analysis_buffer(&dsp, int(count));
        if (source != nullptr && count != 0)
            source(buffer, fixture.channels, int(count), written);
        for (std::uint64_t n = written; source == nullptr && n < written + count; ++n)
            for (int c = 0; c < fixture.channels; ++c)
                buffer[c][n - written] = float(0.3 * std::sin(1e-7 * double(n * n)));
        vorbis_analysis_wrote(&dsp, int(count));
        while (vorbis_analysis_blockout(&dsp, &block) == 1)
        {
            vorbis_analysis(&block, nullptr);
            vorbis_bitrate_addblock(&block);
            ogg_packet packet;
            while (vorbis_bitrate_flushpacket(&dsp, &packet) == 1)
            {
                ogg_stream_packetin(&stream, &packet);
                while (ogg_stream_pageout(&stream, &page) != 0)
                    Append(out, page);
            }
        }
    }
    while (ogg_stream_flush(&stream, &page) != 0)
        Append(out, page);
    ogg_stream_clear(&stream);
    vorbis_block_clear(&block);
    vorbis_dsp_clear(&dsp);
    vorbis_comment_clear(&comment);
    vorbis_info_clear(&info);
    return out;
}

} // namespace testing_support
