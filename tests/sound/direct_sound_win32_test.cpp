// DirectSound paths that the real device never takes here (each failing step
// of Init with its message), and the formats the real device makes static
// buffers of.
#include "sound/direct_sound_win32.h"
#include "sound/wave_format.h"
#include "tests/support/sound_device_fixture.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace
{

// The primary buffer of the fake device: setting its format and asking it
// for the listener fail as the test says.
class FakeBuffer : public IDirectSoundBuffer8
{
public:
    HRESULT setFormatResult = DS_OK;
    HRESULT queryResult = DS_OK;

    STDMETHOD(QueryInterface)(REFIID, void** object) override
    {
        *object = SUCCEEDED(queryResult) ? this : nullptr;
        return queryResult;
    }
    STDMETHOD_(ULONG, AddRef)() override { return 1; }
    STDMETHOD_(ULONG, Release)() override { return 1; }
    STDMETHOD(GetCaps)(LPDSBCAPS) override { return E_NOTIMPL; }
    STDMETHOD(GetCurrentPosition)(LPDWORD, LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetFormat)(LPWAVEFORMATEX, DWORD, LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetVolume)(LPLONG) override { return E_NOTIMPL; }
    STDMETHOD(GetPan)(LPLONG) override { return E_NOTIMPL; }
    STDMETHOD(GetFrequency)(LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetStatus)(LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(Initialize)(LPDIRECTSOUND, LPCDSBUFFERDESC) override { return E_NOTIMPL; }
    STDMETHOD(Lock)(DWORD, DWORD, LPVOID*, LPDWORD, LPVOID*, LPDWORD, DWORD) override
    {
        return E_NOTIMPL;
    }
    STDMETHOD(Play)(DWORD, DWORD, DWORD) override { return E_NOTIMPL; }
    STDMETHOD(SetCurrentPosition)(DWORD) override { return E_NOTIMPL; }
    STDMETHOD(SetFormat)(LPCWAVEFORMATEX) override { return setFormatResult; }
    STDMETHOD(SetVolume)(LONG) override { return E_NOTIMPL; }
    STDMETHOD(SetPan)(LONG) override { return E_NOTIMPL; }
    STDMETHOD(SetFrequency)(DWORD) override { return E_NOTIMPL; }
    STDMETHOD(Stop)() override { return E_NOTIMPL; }
    STDMETHOD(Unlock)(LPVOID, DWORD, LPVOID, DWORD) override { return E_NOTIMPL; }
    STDMETHOD(Restore)() override { return E_NOTIMPL; }
    STDMETHOD(SetFX)(DWORD, LPDSEFFECTDESC, LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(AcquireResources)(DWORD, DWORD, LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetObjectInPath)(REFGUID, DWORD, REFGUID, LPVOID*) override { return E_NOTIMPL; }
};

// A device whose steps fail as the test says.
class FakeDevice : public IDirectSound8
{
public:
    HRESULT cooperativeResult = DS_OK;
    HRESULT createBufferResult = DS_OK;
    HRESULT capsResult = DS_OK;
    FakeBuffer primary;
    int releases = 0;

    STDMETHOD(QueryInterface)(REFIID, void**) override { return E_NOINTERFACE; }
    STDMETHOD_(ULONG, AddRef)() override { return 1; }
    STDMETHOD_(ULONG, Release)() override { return ++releases, 1; }
    STDMETHOD(CreateSoundBuffer)(LPCDSBUFFERDESC, LPLPDIRECTSOUNDBUFFER buffer, IUnknown*) override
    {
        // The layouts agree: IDirectSoundBuffer8 extends IDirectSoundBuffer.
        *buffer = reinterpret_cast<IDirectSoundBuffer*>(&primary);
        return createBufferResult;
    }
    STDMETHOD(GetCaps)(LPDSCAPS) override { return capsResult; }
    STDMETHOD(DuplicateSoundBuffer)(LPDIRECTSOUNDBUFFER, LPLPDIRECTSOUNDBUFFER) override
    {
        return E_NOTIMPL;
    }
    STDMETHOD(SetCooperativeLevel)(HWND, DWORD) override { return cooperativeResult; }
    STDMETHOD(Compact)() override { return E_NOTIMPL; }
    STDMETHOD(GetSpeakerConfig)(LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(SetSpeakerConfig)(DWORD) override { return E_NOTIMPL; }
    STDMETHOD(Initialize)(LPCGUID) override { return E_NOTIMPL; }
    STDMETHOD(VerifyCertification)(LPDWORD) override { return E_NOTIMPL; }
};

FakeDevice* fakeDevice = nullptr;
bool createFails = false;
std::vector<std::string> boxes; // "caption: text"

HRESULT WINAPI CreateFake(LPCGUID, LPDIRECTSOUND8* device, LPUNKNOWN)
{
    *device = createFails ? nullptr : fakeDevice;
    return createFails ? DSERR_NODRIVER : DS_OK;
}

int WINAPI RecordBox(HWND owner, LPCSTR text, LPCSTR caption, UINT type)
{
    const bool plain = owner == nullptr && type == MB_OK;
    boxes.push_back(std::string(plain ? "" : "(owned or not MB_OK) ") + caption + ": " + text);
    return IDOK;
}

} // namespace

TEST(DirectSoundInit, EachFailingStepShowsItsMessageReleasesWhatItGotAndFails)
{
    const struct
    {
        const char* box; // nullptr: none
        void (*arrange)(FakeDevice&);
    } cases[] = {
        {"Error: DirectSound8オブジェクトの生成に失敗しました",
         [](FakeDevice&) { createFails = true; }},
        {"Error: DirectSoumd8\n協調設定に失敗しました",
         [](FakeDevice& d) { d.cooperativeResult = DSERR_INVALIDPARAM; }},
        {"Error: DirectSound8\nプライマリバッファの作成に失敗しました",
         [](FakeDevice& d) { d.createBufferResult = DSERR_OUTOFMEMORY; }},
        {"Error: DirectSound8\nプライマリバッファの設定に失敗しました",
         [](FakeDevice& d) { d.primary.setFormatResult = DSERR_BADFORMAT; }},
        {"Error: DirectSound8\nサウンドリスナーの作成に失敗しました",
         [](FakeDevice& d) { d.primary.queryResult = E_NOINTERFACE; }},
        {nullptr, [](FakeDevice& d) { d.capsResult = DSERR_GENERIC; }},
    };
    for (const auto& c : cases)
    {
        FakeDevice device;
        fakeDevice = &device;
        createFails = false;
        boxes.clear();
        c.arrange(device);
        {
            sound::CSound sound;
            EXPECT_FALSE(
                sound.InitWith(testing_support::TestWindowHandle(), {CreateFake, RecordBox}));
            EXPECT_EQ(boxes, c.box ? std::vector<std::string>{c.box} : std::vector<std::string>{});
            EXPECT_EQ(sound::CurrentSound(), nullptr);
        }
        EXPECT_EQ(device.releases, createFails ? 0 : 1) << (c.box ? c.box : "caps");
    }
}

TEST(DirectSoundDevice, WithoutADeviceNoBufferCanBeMade)
{
    ASSERT_EQ(sound::CurrentSound(), nullptr);
    sound::WaveFormat format{1, 1, 8000, 8000, 1, 8, 0};
    std::uint8_t bytes[16] = {};
    std::uint8_t* pcm = bytes;
    EXPECT_EQ(sound::device::CreateStaticBuffer(format, sound::kCapsStatic, pcm, sizeof bytes),
              nullptr);
}

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

FormatBlock Extensible(WORD bits, WORD validBits, const GUID& subFormat)
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

GUID AdpcmSubFormat()
{
    GUID adpcm = KSDATAFORMAT_SUBTYPE_PCM;
    adpcm.Data1 = WAVE_FORMAT_ADPCM;
    return adpcm;
}

// B-format surround: PCM samples, yet not the PCM sub-format, though its
// GUID starts like it.
constexpr GUID kAmbisonicPcmSubFormat{
    0x00000001, 0x0721, 0x11D3, {0x86, 0x44, 0xC8, 0xC1, 0xCA, 0x00, 0x00, 0x00}};

} // namespace

// What IDirectSound8::CreateSoundBuffer answers for the static buffer of a
// check, measured under Wine, and what the POSIX stand-in answers through
// IsPlayableFormat: the same, row by row. Windows documents part of it:
// compressed formats only in hardware buffers, which the check never asks
// for; block align = channels x bytes per sample; whole-byte containers, at
// least 22 extra bytes and no more valid bits than bits for the extensible
// format. Where it only says "should" (bytes per second = rate x block
// align), or speaks of SetFrequency rather than of a format
// (DSBFREQUENCY_MIN and _MAX), Wine refuses nothing and the stand-in
// neither. Pages for pre-WDM drivers limit software buffers to 8 and 16
// bits; those for WDM drivers take wider, float and multichannel formats,
// as Wine does.
TEST(DirectSoundFormats, TheStandInRefusesExactlyWhatDirectSoundRefuses)
{
    struct Row
    {
        const char* protects;
        FormatBlock block;
        bool accepted;
    };
    const Row rows[] = {
        {"16-bit stereo PCM", Plain(WAVE_FORMAT_PCM, 2, 44100, 16), true},
        {"12-bit samples are not whole bytes", Plain(WAVE_FORMAT_PCM, 2, 44100, 12), false},
        {"a block align other than channels x bytes per sample",
         With(Plain(WAVE_FORMAT_PCM, 2, 44100, 16), [](auto& f) { f.Format.nBlockAlign = 8; }),
         false},
        {"no bytes per second",
         With(Plain(WAVE_FORMAT_PCM, 2, 44100, 16), [](auto& f) { f.Format.nAvgBytesPerSec = 0; }),
         false},
        {"any other bytes per second",
         With(Plain(WAVE_FORMAT_PCM, 2, 44100, 16), [](auto& f) { f.Format.nAvgBytesPerSec = 1; }),
         true},
        {"a compressed format tag", Plain(WAVE_FORMAT_ADPCM, 2, 44100, 16), false},
        {"IEEE float samples of 64 bits", Plain(WAVE_FORMAT_IEEE_FLOAT, 2, 44100, 64), true},
        {"eight channels", Plain(WAVE_FORMAT_PCM, 8, 44100, 16), true},
        {"1 Hz, below DSBFREQUENCY_MIN", Plain(WAVE_FORMAT_PCM, 1, 1, 8), true},
        {"384000 Hz, above DSBFREQUENCY_MAX", Plain(WAVE_FORMAT_PCM, 2, 384000, 16), true},
        {"extensible PCM of 24 valid bits in 32", Extensible(32, 24, KSDATAFORMAT_SUBTYPE_PCM),
         true},
        {"extensible without its extra bytes",
         With(Extensible(16, 16, KSDATAFORMAT_SUBTYPE_PCM), [](auto& f) { f.Format.cbSize = 0; }),
         false},
        {"extensible of a sub-format other than PCM and float",
         Extensible(16, 16, AdpcmSubFormat()), false},
        {"extensible of Ambisonic B-format", Extensible(16, 16, kAmbisonicPcmSubFormat), false},
        {"extensible with more valid bits than bits", Extensible(16, 17, KSDATAFORMAT_SUBTYPE_PCM),
         false},
        {"extensible with extra bytes beyond its own",
         With(Extensible(16, 16, KSDATAFORMAT_SUBTYPE_PCM), [](auto& f) { f.Format.cbSize = 23; }),
         false},
        // Wine's allowance for writers that count the whole structure.
        {"extensible counting its whole structure as extra bytes",
         With(Extensible(32, 32, KSDATAFORMAT_SUBTYPE_IEEE_FLOAT),
              [](auto& f) { f.Format.cbSize = sizeof(WAVEFORMATEXTENSIBLE); }),
         true},
    };
    testing_support::ScopedSoundDevice device;
    ASSERT_TRUE(device.Ready());
    std::vector<std::uint8_t> pcm(1024);
    for (const Row& row : rows)
    {
        const auto& format = reinterpret_cast<const sound::WaveFormat&>(row.block);
        std::uint8_t* data = pcm.data();
        sound::DeviceBuffer* buffer = sound::device::CreateStaticBuffer(
            format, sound::kCapsStatic, data, static_cast<std::uint32_t>(pcm.size()));
        EXPECT_EQ(buffer != nullptr, row.accepted) << "DirectSound: " << row.protects;
        EXPECT_EQ(sound::IsPlayableFormat(format), row.accepted)
            << "IsPlayableFormat: " << row.protects;
        if (buffer != nullptr)
            sound::device::Release(buffer);
    }
}
