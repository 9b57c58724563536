#pragma once

// Music of a given length and a way to parse a text against it.
#include "sound/sound_buffer.h"
#include "tension/tension_file.h"

#include <string>

namespace tension_testing
{

// A sound buffer of `seconds` (8-bit mono at 1000 Hz, so any length to the
// millisecond), opened once per length and kept for the test program.
sound::CSoundBuffer* Music(double seconds);

struct Outcome
{
    bool accepted;
    std::string log;
};

// Parses `text`, copied into a block of exactly its size so that a read
// past its terminating zero is caught, with ":" and ";".
Outcome Parse(tension::CTensionFile& file, const std::string& text, double seconds);
Outcome Parse(const std::string& text, double seconds);

// The messages, each with its line feed.
std::string Lines(std::initializer_list<const char*> messages);

} // namespace tension_testing
