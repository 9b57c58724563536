// The tension parser and its checks over any text, against music of a length
// taken from the input. Besides never crashing or reading past the text:
// - the timeline starts with (0, Normal), ends with a key at the music's
//   length (unless the music is too short for two keys) and holds every
//   other key inside it, in ascending order of time;
// - every message of the log ends with a line feed;
// - an accepted file has a name of 1 to 40 bytes and a comment of at most 160.
// The game's queries of the timeline run over the result as well.
#include "fuzz/fuzz_support.h"
#include "tension/tension_file.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>

using fuzzing::Require;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size < fuzzing::kTensionLengthBytes)
        return 0;
    const auto length = static_cast<float>((data[0] | data[1] << 8) * fuzzing::kTensionLengthUnit);
    // An exact copy with its zero, so that a read past the end is caught.
    const std::size_t textBytes = size - fuzzing::kTensionLengthBytes;
    const std::unique_ptr<char[]> text(new char[textBytes + 1]);
    std::memcpy(text.get(), data + fuzzing::kTensionLengthBytes, textBytes);
    text[textBytes] = '\0';

    tension::CTensionFile file;
    tension::CTextString log;
    const bool accepted = file.ParseForLength(length, text.get(), ':', ';', &log);

    Require(log.Length() == 0 || log.CStr()[log.Length() - 1] == '\n',
            "messages end with a line feed");
    if (accepted)
    {
        Require(length >= 60.0f && length <= 480.0f, "accepted music is 60 to 480 s long");
        Require(file.GetName().Length() >= 1 && file.GetName().Length() <= 40,
                "an accepted name is 1 to 40 bytes");
        Require(file.GetComment().Length() <= 160, "an accepted comment is at most 160 bytes");
    }
    const tension::CKeyFrameList* timeline = file.GetTimeline();
    if (timeline == nullptr)
        return 0;
    const std::uint32_t count = timeline->GetKeyCount();
    Require(count >= 1 && timeline->GetKey(0)->time == 0.0f &&
                timeline->GetKey(0)->value == static_cast<int>(tension::TensionLevel::Normal),
            "the timeline starts Normal at 0");
    for (std::uint32_t i = 1; i < count; ++i)
    {
        const tension::KeyFrame* key = timeline->GetKey(i);
        Require(key->time > timeline->GetKey(i - 1)->time, "keys ascend in time");
        Require(key->time <= length, "keys lie inside the music");
        Require(key->value >= 0 && key->value <= 3, "keys hold a level");
    }
    if (length > tension::CKeyFrameList::kMinimumKeyDistance)
        Require(timeline->GetKey(count - 1)->time == length, "the last key closes the music");
    for (const float time : {0.0f, length * 0.5f, length, length * 2.5f, file.GetFinaleTime()})
    {
        const auto level = static_cast<std::int32_t>(file.GetTension(time));
        Require(level >= 0 && level <= 3, "the timeline answers a level");
        file.IsFinale(time);
    }
    return 0;
}
