// The formats the real device makes static buffers of, and the stand-in's
// agreement with it.
#include "sound/direct_sound_win32.h"
#include "sound/wave_format.h"
#include "tests/support/sound_device_fixture.h"

#include <gtest/gtest.h>
#include <tuple>
#include <vector>

namespace
{

// A "fmt " chunk as a file gives it: WAVEFORMATEXTENSIBLE, with room for 40
// extra bytes rather than its own 22.
struct FormatBlock
{
    WAVEFORMATEXTENSIBLE format;
    BYTE moreExtra[sizeof(WAVEFORMATEX)];
};

FormatBlock Plain(WORD tag, WORD channels, DWORD rate, WORD bits)
{
    FormatBlock block{};
    WAVEFORMATEX& format = block.format.Format;
    format.wFormatTag = tag;
    format.nChannels = channels;
    format.nSamplesPerSec = rate;
    format.wBitsPerSample = bits;
    format.nBlockAlign = static_cast<WORD>(channels * bits / 8);
    format.nAvgBytesPerSec = rate * format.nBlockAlign;
    return block;
}

FormatBlock Extensible(WORD bits = 16, WORD validBits = 16,
                       const GUID& subFormat = KSDATAFORMAT_SUBTYPE_PCM)
{
    FormatBlock block = Plain(WAVE_FORMAT_EXTENSIBLE, 2, 44100, bits);
    block.format.Format.cbSize = sizeof(WAVEFORMATEXTENSIBLE) - sizeof(WAVEFORMATEX);
    block.format.Samples.wValidBitsPerSample = validBits;
    block.format.dwChannelMask = SPEAKER_FRONT_LEFT | SPEAKER_FRONT_RIGHT;
    block.format.SubFormat = subFormat;
    return block;
}

template <typename Change> FormatBlock With(FormatBlock block, Change change)
{
    change(block.format);
    return block;
}

// ADPCM as a sub-format; and B-format surround: PCM samples, yet not the
// PCM sub-format, though its GUID starts like it.
constexpr GUID kAdpcmSubFormat{
    WAVE_FORMAT_ADPCM, 0x0000, 0x0010, {0x80, 0x00, 0x00, 0xAA, 0x00, 0x38, 0x9B, 0x71}};
constexpr GUID kAmbisonicPcmSubFormat{
    0x00000001, 0x0721, 0x11D3, {0x86, 0x44, 0xC8, 0xC1, 0xCA, 0x00, 0x00, 0x00}};

} // namespace

// What CreateSoundBuffer answers for a check's static buffer, measured under
// Wine, and what the POSIX stand-in answers: the same, row by row (what
// Windows documents of it: docs/reliability.md).
TEST(DirectSoundFormats, TheStandInRefusesExactlyWhatDirectSoundRefuses)
{
    const FormatBlock pcm16 = Plain(WAVE_FORMAT_PCM, 2, 44100, 16);
    // What the row protects, the format and whether both accept it.
    const std::tuple<const char*, FormatBlock, bool> rows[] = {
        {"16-bit stereo PCM", pcm16, true},
        {"12-bit samples are not whole bytes", Plain(WAVE_FORMAT_PCM, 2, 44100, 12), false},
        {"a block align other than channels x bytes per sample",
         With(pcm16, [](auto& f) { f.Format.nBlockAlign = 8; }), false},
        {"no bytes per second", With(pcm16, [](auto& f) { f.Format.nAvgBytesPerSec = 0; }), false},
        {"any other bytes per second", With(pcm16, [](auto& f) { f.Format.nAvgBytesPerSec = 1; }),
         true},
        {"a compressed format tag", Plain(WAVE_FORMAT_ADPCM, 2, 44100, 16), false},
        {"IEEE float samples of 64 bits", Plain(WAVE_FORMAT_IEEE_FLOAT, 2, 44100, 64), true},
        {"eight channels", Plain(WAVE_FORMAT_PCM, 8, 44100, 16), true},
        {"1 Hz, below DSBFREQUENCY_MIN", Plain(WAVE_FORMAT_PCM, 1, 1, 8), true},
        {"384000 Hz, above DSBFREQUENCY_MAX", Plain(WAVE_FORMAT_PCM, 2, 384000, 16), true},
        {"extensible PCM of 24 valid bits in 32", Extensible(32, 24), true},
        {"extensible without its extra bytes",
         With(Extensible(), [](auto& f) { f.Format.cbSize = 0; }), false},
        {"extensible of a sub-format other than PCM and float", Extensible(16, 16, kAdpcmSubFormat),
         false},
        {"extensible of Ambisonic B-format", Extensible(16, 16, kAmbisonicPcmSubFormat), false},
        {"extensible with more valid bits than bits", Extensible(16, 17), false},
        {"extensible with extra bytes beyond its own",
         With(Extensible(), [](auto& f) { f.Format.cbSize = 23; }), false},
        // Wine's allowance for writers that count the whole structure.
        {"extensible counting its whole structure as extra bytes",
         With(Extensible(32, 32, KSDATAFORMAT_SUBTYPE_IEEE_FLOAT),
              [](auto& f) { f.Format.cbSize = sizeof(WAVEFORMATEXTENSIBLE); }),
         true},
    };
    testing_support::ScopedSoundDevice device;
    ASSERT_TRUE(device.Ready());
    std::vector<std::uint8_t> samples(1024);
    for (const auto& [protects, block, accepted] : rows)
    {
        const auto& format = reinterpret_cast<const sound::WaveFormat&>(block);
        std::uint8_t* data = samples.data();
        sound::DeviceBuffer* buffer = sound::device::CreateStaticBuffer(
            format, sound::kCapsStatic, data, static_cast<std::uint32_t>(samples.size()));
        EXPECT_EQ(buffer != nullptr, accepted) << "DirectSound: " << protects;
        EXPECT_EQ(sound::IsPlayableFormat(format), accepted) << "IsPlayableFormat: " << protects;
        if (buffer != nullptr)
            sound::device::Release(buffer);
    }
}
