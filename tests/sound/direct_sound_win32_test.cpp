// DirectSound paths that the real device never takes here: each failing step
// of Init with its message, and a buffer lost during the first lock.
#include "sound/direct_sound_win32.h"
#include "tests/support/sound_device_fixture.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace
{

// A DirectSound buffer that does what the test says: a lock may report the
// buffer lost a given number of times.
class FakeBuffer : public IDirectSoundBuffer8
{
public:
    explicit FakeBuffer(DWORD bytes) : memory(bytes) {}

    int lostLocks = 0;
    int locks = 0;
    int restores = 0;
    int unlocks = 0;
    int releases = 0;
    HRESULT setFormatResult = DS_OK;
    HRESULT queryResult = DS_OK;
    std::vector<BYTE> memory;

    STDMETHOD(QueryInterface)(REFIID, void** object) override
    {
        *object = SUCCEEDED(queryResult) ? this : nullptr;
        return queryResult;
    }
    STDMETHOD_(ULONG, AddRef)() override { return 1; }
    STDMETHOD_(ULONG, Release)() override { return ++releases, 1; }
    STDMETHOD(GetCaps)(LPDSBCAPS) override { return E_NOTIMPL; }
    STDMETHOD(GetCurrentPosition)(LPDWORD, LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetFormat)(LPWAVEFORMATEX, DWORD, LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetVolume)(LPLONG) override { return E_NOTIMPL; }
    STDMETHOD(GetPan)(LPLONG) override { return E_NOTIMPL; }
    STDMETHOD(GetFrequency)(LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(GetStatus)(LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(Initialize)(LPDIRECTSOUND, LPCDSBUFFERDESC) override { return E_NOTIMPL; }
    STDMETHOD(Lock)
    (DWORD, DWORD, LPVOID* first, LPDWORD firstBytes, LPVOID* second, LPDWORD secondBytes,
     DWORD) override
    {
        ++locks;
        if (lostLocks > 0)
        {
            --lostLocks;
            return DSERR_BUFFERLOST;
        }
        *first = memory.data();
        *firstBytes = static_cast<DWORD>(memory.size());
        if (second != nullptr)
            *second = nullptr;
        if (secondBytes != nullptr)
            *secondBytes = 0;
        return DS_OK;
    }
    STDMETHOD(Play)(DWORD, DWORD, DWORD) override { return E_NOTIMPL; }
    STDMETHOD(SetCurrentPosition)(DWORD) override { return E_NOTIMPL; }
    STDMETHOD(SetFormat)(LPCWAVEFORMATEX) override { return setFormatResult; }
    STDMETHOD(SetVolume)(LONG) override { return E_NOTIMPL; }
    STDMETHOD(SetPan)(LONG) override { return E_NOTIMPL; }
    STDMETHOD(SetFrequency)(DWORD) override { return E_NOTIMPL; }
    STDMETHOD(Stop)() override { return E_NOTIMPL; }
    STDMETHOD(Unlock)(LPVOID, DWORD, LPVOID, DWORD) override { return ++unlocks, DS_OK; }
    STDMETHOD(Restore)() override { return ++restores, DS_OK; }
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
    FakeBuffer primary{0};
    int releases = 0;
    HWND cooperativeWindow = nullptr;
    DWORD cooperativeLevel = 0;
    DWORD primaryFlags = 0;

    STDMETHOD(QueryInterface)(REFIID, void**) override { return E_NOINTERFACE; }
    STDMETHOD_(ULONG, AddRef)() override { return 1; }
    STDMETHOD_(ULONG, Release)() override { return ++releases, 1; }
    STDMETHOD(CreateSoundBuffer)
    (LPCDSBUFFERDESC description, LPLPDIRECTSOUNDBUFFER buffer, IUnknown*) override
    {
        primaryFlags = description->dwFlags;
        if (FAILED(createBufferResult))
            return createBufferResult;
        // The layouts agree: IDirectSoundBuffer8 extends IDirectSoundBuffer.
        *buffer = reinterpret_cast<IDirectSoundBuffer*>(&primary);
        return DS_OK;
    }
    STDMETHOD(GetCaps)(LPDSCAPS caps) override
    {
        if (FAILED(capsResult))
            return capsResult;
        caps->dwMaxSecondarySampleRate = 96000;
        caps->dwMinSecondarySampleRate = 100;
        caps->dwTotalHwMemBytes = 7;
        caps->dwFreeHwMemBytes = 5;
        caps->dwFlags = 0x30;
        return DS_OK;
    }
    STDMETHOD(DuplicateSoundBuffer)(LPDIRECTSOUNDBUFFER, LPLPDIRECTSOUNDBUFFER) override
    {
        return E_NOTIMPL;
    }
    STDMETHOD(SetCooperativeLevel)(HWND window, DWORD level) override
    {
        cooperativeWindow = window;
        cooperativeLevel = level;
        return cooperativeResult;
    }
    STDMETHOD(Compact)() override { return E_NOTIMPL; }
    STDMETHOD(GetSpeakerConfig)(LPDWORD) override { return E_NOTIMPL; }
    STDMETHOD(SetSpeakerConfig)(DWORD) override { return E_NOTIMPL; }
    STDMETHOD(Initialize)(LPCGUID) override { return E_NOTIMPL; }
    STDMETHOD(VerifyCertification)(LPDWORD) override { return E_NOTIMPL; }
};

struct Box
{
    HWND owner;
    std::string text;
    std::string caption;
    UINT type;
};

FakeDevice* fakeDevice = nullptr;
bool createFails = false;
std::vector<Box> boxes;

HRESULT WINAPI CreateFake(LPCGUID, LPDIRECTSOUND8* device, LPUNKNOWN)
{
    if (createFails)
        return DSERR_NODRIVER;
    *device = fakeDevice;
    return DS_OK;
}

int WINAPI RecordBox(HWND owner, LPCSTR text, LPCSTR caption, UINT type)
{
    boxes.push_back(Box{owner, text, caption, type});
    return IDOK;
}

const sound::DeviceApi kFakeApi{CreateFake, RecordBox};

class InitTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        fakeDevice = &device;
        createFails = false;
        boxes.clear();
    }
    void TearDown() override { fakeDevice = nullptr; }

    FakeDevice device;
};

} // namespace

TEST(DirectSoundFill, ALostBufferIsRestoredAndLockedOnceMore)
{
    FakeBuffer buffer(8);
    buffer.lostLocks = 1;
    const BYTE pcm[8] = {1, 2, 3, 4, 5, 6, 7, 8};
    ASSERT_TRUE(sound::device::FillStaticBuffer(&buffer, pcm, sizeof pcm));
    EXPECT_EQ(buffer.restores, 1);
    EXPECT_EQ(buffer.locks, 2);
    EXPECT_EQ(buffer.unlocks, 1);
    EXPECT_EQ(buffer.memory, std::vector<BYTE>(pcm, pcm + 8));
}

TEST(DirectSoundFill, GivesUpWhenTheSecondLockFailsToo)
{
    FakeBuffer buffer(8);
    buffer.lostLocks = 2;
    const BYTE pcm[8] = {};
    EXPECT_FALSE(sound::device::FillStaticBuffer(&buffer, pcm, sizeof pcm));
    EXPECT_EQ(buffer.restores, 1);
    EXPECT_EQ(buffer.locks, 2);
    EXPECT_EQ(buffer.unlocks, 0);
}

TEST(DirectSoundFill, ABufferThatLocksAtOnceIsNotRestored)
{
    FakeBuffer buffer(4);
    const BYTE pcm[4] = {9, 8, 7, 6};
    ASSERT_TRUE(sound::device::FillStaticBuffer(&buffer, pcm, sizeof pcm));
    EXPECT_EQ(buffer.restores, 0);
    EXPECT_EQ(buffer.locks, 1);
}

TEST_F(InitTest, EveryStepSucceedsAndTheCapsAreKept)
{
    {
        sound::CSound sound;
        HWND window = static_cast<HWND>(testing_support::TestWindowHandle());
        ASSERT_TRUE(sound.InitWith(window, kFakeApi));
        EXPECT_TRUE(boxes.empty());
        EXPECT_EQ(device.cooperativeWindow, window);
        EXPECT_EQ(device.cooperativeLevel, static_cast<DWORD>(DSSCL_PRIORITY));
        EXPECT_EQ(device.primaryFlags, 0x91u);
        EXPECT_EQ(sound.GetMaxSecondaryRate(), 96000u);
        EXPECT_EQ(sound.GetMinSecondaryRate(), 100u);
        EXPECT_EQ(sound.GetTotalHardwareMemory(), 7u);
        EXPECT_EQ(sound.GetFreeHardwareMemory(), 5u);
        EXPECT_EQ(sound.GetCapsFlags(), 0x30u);
        EXPECT_EQ(sound::CurrentSound(), &sound);
    }
    EXPECT_EQ(device.primary.releases, 2) << "the listener and the primary buffer";
    EXPECT_EQ(device.releases, 1);
    EXPECT_EQ(sound::CurrentSound(), nullptr);
}

TEST_F(InitTest, EachFailingStepShowsItsMessageAndFails)
{
    struct Case
    {
        const char* message;
        void (*arrange)(FakeDevice&);
    };
    const Case cases[] = {
        {"DirectSound8オブジェクトの生成に失敗しました", [](FakeDevice&) { createFails = true; }},
        {"DirectSoumd8\n協調設定に失敗しました",
         [](FakeDevice& d) { d.cooperativeResult = DSERR_INVALIDPARAM; }},
        {"DirectSound8\nプライマリバッファの作成に失敗しました",
         [](FakeDevice& d) { d.createBufferResult = DSERR_OUTOFMEMORY; }},
        {"DirectSound8\nプライマリバッファの設定に失敗しました",
         [](FakeDevice& d) { d.primary.setFormatResult = DSERR_BADFORMAT; }},
        {"DirectSound8\nサウンドリスナーの作成に失敗しました",
         [](FakeDevice& d) { d.primary.queryResult = E_NOINTERFACE; }},
    };
    for (const Case& c : cases)
    {
        FakeDevice fresh;
        fakeDevice = &fresh;
        createFails = false;
        boxes.clear();
        c.arrange(fresh);
        {
            sound::CSound sound;
            EXPECT_FALSE(sound.InitWith(testing_support::TestWindowHandle(), kFakeApi));
            ASSERT_EQ(boxes.size(), 1u) << c.message;
            EXPECT_EQ(boxes[0].text, c.message);
            EXPECT_EQ(boxes[0].caption, "Error");
            EXPECT_EQ(boxes[0].owner, nullptr);
            EXPECT_EQ(boxes[0].type, static_cast<UINT>(MB_OK));
            EXPECT_EQ(sound::CurrentSound(), nullptr);
        }
        if (!createFails)
        {
            EXPECT_EQ(fresh.releases, 1) << "what was obtained is released at destruction";
        }
    }
}

TEST_F(InitTest, AFailingGetCapsFailsWithoutAMessage)
{
    device.capsResult = DSERR_GENERIC;
    sound::CSound sound;
    EXPECT_FALSE(sound.InitWith(testing_support::TestWindowHandle(), kFakeApi));
    EXPECT_TRUE(boxes.empty());
    EXPECT_EQ(sound::CurrentSound(), nullptr);
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
