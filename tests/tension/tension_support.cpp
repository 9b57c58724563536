#include "tests/tension/tension_support.h"

#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <cstring>
#include <gtest/gtest.h>
#include <map>
#include <memory>

namespace tension_testing
{
namespace
{

struct MusicShelf
{
    testing_support::ScopedSoundDevice device;
    testing_support::TempFolder folder;
    std::map<double, std::unique_ptr<sound::CSoundBuffer>> buffers;
};

MusicShelf& Shelf()
{
    static MusicShelf shelf;
    return shelf;
}

} // namespace

sound::CSoundBuffer* Music(double seconds)
{
    MusicShelf& shelf = Shelf();
    auto& slot = shelf.buffers[seconds];
    if (!slot)
    {
        const std::string path =
            shelf.folder.File("music-" + std::to_string(shelf.buffers.size()) + ".wav");
        testing_support::WriteBytes(path, testing_support::MakeWaveOfLength(seconds));
        slot = std::make_unique<sound::CSoundBuffer>();
        EXPECT_TRUE(shelf.device.Ready());
        EXPECT_TRUE(slot->Open(path.c_str(), 1, sound::kCapsStatic)) << seconds;
    }
    return slot.get();
}

Outcome Parse(tension::CTensionFile& file, const std::string& text, double seconds)
{
    const std::unique_ptr<char[]> exact(new char[text.size() + 1]);
    std::memcpy(exact.get(), text.c_str(), text.size() + 1);
    tension::CTextString log;
    const bool accepted = file.Parse(Music(seconds), exact.get(), ':', ';', &log);
    return Outcome{accepted, log.CStr()};
}

Outcome Parse(const std::string& text, double seconds)
{
    tension::CTensionFile file;
    return Parse(file, text, seconds);
}

std::string Lines(std::initializer_list<const char*> messages)
{
    std::string lines;
    for (const char* message : messages)
        lines += std::string(message) + "\n";
    return lines;
}

} // namespace tension_testing
