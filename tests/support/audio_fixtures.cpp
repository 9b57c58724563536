#include "tests/support/audio_fixtures.h"

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

void PutId(Bytes& out, const char* id)
{
    for (int i = 0; i < 4; ++i)
        out.push_back(static_cast<std::uint8_t>(id[i]));
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
    PutId(chunks_, id);
    PutU32(chunks_, claimedSize);
    chunks_.insert(chunks_.end(), body.begin(), body.end());
    if (body.size() % 2 != 0)
        chunks_.push_back(0);
    return *this;
}

Bytes RiffWriter::Finish(const char* form) const
{
    Bytes out;
    PutId(out, "RIFF");
    PutU32(out, static_cast<std::uint32_t>(4 + chunks_.size()));
    PutId(out, form);
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
    WaveSpec fixture;
    fixture.channels = 1;
    fixture.sampleRate = 1000;
    fixture.bitsPerSample = 8;
    fixture.dataBytes = static_cast<std::uint32_t>(std::llround(seconds * 1000.0));
    return MakeWave(fixture);
}

SampleSource TuneSource(long sampleRate)
{
    return [sampleRate](float** channels, int channelCount, int count, std::uint64_t first)
    {
        constexpr double kTwoPi = 6.283185307179586;
        for (int i = 0; i < count; ++i)
        {
            const double t = double(first + i) / double(sampleRate);
            // A melody of three voices whose notes change every quarter second.
            const int step = static_cast<int>(t * 4.0);
            const double root = 220.0 * std::pow(2.0, ((step * 5) % 12) / 12.0);
            const double value = 0.25 * std::sin(kTwoPi * root * t) +
                                 0.15 * std::sin(kTwoPi * root * 1.5 * t) +
                                 0.10 * std::sin(kTwoPi * root * 2.01 * t);
            for (int c = 0; c < channelCount; ++c)
                channels[c][i] = static_cast<float>(value * (c % 2 == 0 ? 1.0 : 0.8));
        }
    };
}

Bytes EncodeOggVorbis(const OggFixture& fixture)
{
    return EncodeOggVorbis(fixture, TuneSource(fixture.sampleRate));
}

Bytes EncodeOggVorbis(const OggFixture& fixture, const SampleSource& source)
{
    vorbis_info info;
    vorbis_info_init(&info);
    if (vorbis_encode_init_vbr(&info, fixture.channels, fixture.sampleRate, fixture.quality) != 0)
    {
        vorbis_info_clear(&info);
        throw std::runtime_error("libvorbisenc refused the encoder settings");
    }
    vorbis_comment comment;
    vorbis_comment_init(&comment);
    vorbis_dsp_state dsp;
    vorbis_analysis_init(&dsp, &info);
    vorbis_block block;
    vorbis_block_init(&dsp, &block);
    ogg_stream_state stream;
    ogg_stream_init(&stream, 0x56454B);

    Bytes out;
    ogg_packet header, commentHeader, codeHeader;
    vorbis_analysis_headerout(&dsp, &comment, &header, &commentHeader, &codeHeader);
    ogg_stream_packetin(&stream, &header);
    ogg_stream_packetin(&stream, &commentHeader);
    ogg_stream_packetin(&stream, &codeHeader);
    ogg_page page;
    while (ogg_stream_flush(&stream, &page) != 0)
        Append(out, page);

    constexpr int kBlock = 1024;
    std::uint64_t written = 0;
    bool ended = false;
    while (!ended)
    {
        const std::uint64_t left = fixture.samplesPerChannel - written;
        const int count = left < kBlock ? static_cast<int>(left) : kBlock;
        if (count == 0)
        {
            vorbis_analysis_wrote(&dsp, 0);
        }
        else
        {
            float** buffer = vorbis_analysis_buffer(&dsp, count);
            source(buffer, fixture.channels, count, written);
            vorbis_analysis_wrote(&dsp, count);
            written += count;
        }
        while (vorbis_analysis_blockout(&dsp, &block) == 1)
        {
            vorbis_analysis(&block, nullptr);
            vorbis_bitrate_addblock(&block);
            ogg_packet packet;
            while (vorbis_bitrate_flushpacket(&dsp, &packet) == 1)
            {
                ogg_stream_packetin(&stream, &packet);
                while (ogg_stream_pageout(&stream, &page) != 0)
                {
                    Append(out, page);
                    ended = ended || ogg_page_eos(&page) != 0;
                }
            }
        }
        if (count == 0)
            ended = true;
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

std::vector<Bytes> SplitOggPages(const Bytes& stream)
{
    std::vector<Bytes> pages;
    std::size_t position = 0;
    while (position + 27 <= stream.size() && std::memcmp(&stream[position], "OggS", 4) == 0)
    {
        const std::size_t segments = stream[position + 26];
        std::size_t size = 27 + segments;
        if (position + size > stream.size())
            break;
        for (std::size_t i = 0; i < segments; ++i)
            size += stream[position + 27 + i];
        if (position + size > stream.size())
            break;
        pages.emplace_back(stream.begin() + position, stream.begin() + position + size);
        position += size;
    }
    return pages;
}

Bytes JoinOggPages(const std::vector<Bytes>& pages)
{
    Bytes out;
    for (const Bytes& page : pages)
        out.insert(out.end(), page.begin(), page.end());
    return out;
}

} // namespace testing_support
