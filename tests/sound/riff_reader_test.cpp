// The RIFF rules of wave files, read from memory.
#include "sound/byte_source.h"
#include "sound/riff_reader.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/temp_folder.h"

#include <array>
#include <cstring>
#include <gtest/gtest.h>
#include <tuple>
#include <utility>

using sound::DecodedAudio;
using testing_support::Bytes;
using testing_support::FormatChunkBody;
using testing_support::PatternBytes;
using testing_support::RiffWriter;
using testing_support::WaveSpec;

namespace
{

// A "fmt " chunk of this body and a "data" chunk of 7 pattern bytes whose
// size field claims `claimed`.
Bytes Wave(const Bytes& format, std::uint32_t claimed = 7)
{
    return RiffWriter()
        .Chunk("fmt ", format)
        .ChunkClaiming("data", claimed, PatternBytes(7))
        .Finish();
}

} // namespace

// Both sources read within their bytes only, an empty read included.
TEST(ByteSources, ReadNothingPastTheEnd)
{
    const testing_support::TempFolder folder;
    const Bytes four = PatternBytes(4);
    testing_support::WriteBytes(folder.File("four"), four);
    sound::MemorySource memory(four.data(), four.size());
    sound::FileSource file;
    ASSERT_TRUE(file.Open(folder.File("four").c_str()));
    const std::tuple<std::uint64_t, std::size_t, bool> rows[] = {
        {3, 1, true}, {4, 0, true}, {3, 2, false}, {5, 0, false}};
    for (sound::ByteSource* source : std::initializer_list<sound::ByteSource*>{&memory, &file})
        for (const auto& [offset, size, read] : rows)
            EXPECT_EQ(source->ReadAt(offset, std::array<std::uint8_t, 2>().data(), size), read)
                << offset << " " << size;
}

TEST(RiffReader, FindsTheFormatAndTheDataWhereTheRulesPutThem)
{
    const Bytes pcm = FormatChunkBody(WaveSpec{});
    const Bytes ieeeFloat = FormatChunkBody(WaveSpec{.formatTag = 3});
    Bytes riffBeyondTheFile = Wave(pcm);
    std::memset(&riffBeyondTheFile[4], 0xFF, 4);
    // What the file is, the file, the format read and the data bytes read.
    const std::tuple<const char*, Bytes, WaveSpec, std::uint32_t> cases[] = {
        {"PCM", Wave(pcm), WaveSpec{}, 7},
        {"other chunks around, odd ones padded",
         RiffWriter()
             .Chunk("LIST", PatternBytes(5))
             .Chunk("fmt ", pcm)
             .Chunk("fact", PatternBytes(4))
             .Chunk("data", PatternBytes(7))
             .Chunk("smpl", PatternBytes(3))
             .Finish(),
         WaveSpec{}, 7},
        {"a RIFF size beyond the file", riffBeyondTheFile, WaveSpec{}, 7},
        {"a data chunk claiming fewer bytes than follow", Wave(pcm, 5), WaveSpec{}, 5},
        {"a non-PCM format keeps its extra bytes",
         Wave(FormatChunkBody(WaveSpec{.formatTag = 0xFFFE, .extra = PatternBytes(22)})),
         WaveSpec{.formatTag = 0xFFFE, .extra = PatternBytes(22)}, 7},
        {"a non-PCM fmt chunk of 16 bytes has none",
         Wave(Bytes(ieeeFloat.begin(), ieeeFloat.begin() + 16)), WaveSpec{.formatTag = 3}, 7},
    };
    for (const auto& [what, file, wave, dataBytes] : cases)
    {
        DecodedAudio audio;
        ASSERT_TRUE(sound::ReadWaveFromMemory(file.data(), file.size(), &audio)) << what;
        // The 16 bytes of the chunk, the count of extra bytes, the extra bytes.
        Bytes block = FormatChunkBody(wave);
        block.resize(18 + wave.extra.size());
        const auto* format = reinterpret_cast<const std::uint8_t*>(audio.format);
        EXPECT_EQ(Bytes(format, format + sound::FormatBytes(*audio.format)), block) << what;
        EXPECT_EQ(Bytes(audio.data, audio.data + audio.dataBytes), PatternBytes(dataBytes)) << what;
    }
}

TEST(RiffReader, RefusesFilesWithoutTheChunksOrTheFormatItNeeds)
{
    const Bytes pcm = FormatChunkBody(WaveSpec{});
    const Bytes extraBeyondTheChunk =
        FormatChunkBody(WaveSpec{.formatTag = 2, .extra = PatternBytes(10)});
    const std::pair<const char*, Bytes> cases[] = {
        {"no RIFF file", PatternBytes(100)},
        {"a RIFF form other than WAVE",
         RiffWriter().Chunk("fmt ", pcm).Chunk("data", PatternBytes(4)).Finish("AVI ")},
        {"no fmt chunk", RiffWriter().Chunk("data", PatternBytes(4)).Finish()},
        {"a fmt chunk of 14 bytes", Wave(Bytes(pcm.begin(), pcm.begin() + 14))},
        {"extra format bytes beyond the fmt chunk",
         Wave(Bytes(extraBeyondTheChunk.begin(), extraBeyondTheChunk.end() - 1))},
        {"no data chunk", RiffWriter().Chunk("fmt ", pcm).Finish()},
        {"a data chunk claiming a byte more than the file has", Wave(pcm, 9)},
        {"no channels", Wave(FormatChunkBody({.channels = 0}))},
        {"no sample rate", Wave(FormatChunkBody({.sampleRate = 0}))},
        {"7 bits per sample", Wave(FormatChunkBody({.bitsPerSample = 7}))},
    };
    for (const auto& [what, file] : cases)
    {
        DecodedAudio audio;
        EXPECT_FALSE(sound::ReadWaveFromMemory(file.data(), file.size(), &audio)) << what;
        EXPECT_TRUE(audio.format == nullptr && audio.data == nullptr) << what;
    }
}
