#include "cli/vekcfg.h"

#include "base/atomic_file.h"
#include "cli/check_report.h"
#include "cli/command_line.h"
#include "cli/encoding.h"
#include "cli/json.h"
#include "cli/platform.h"
#include "cli/row_checks.h"
#include "cli/settings_change.h"
#include "cli/settings_file.h"
#include "cli/settings_report.h"
#include "cli/timeline_svg.h"
#include "config/fixed_text.h"
#include "config/save_config.h"
#include "sound/loudness.h"
#include "sound/sound_buffer.h"
#include "tension/tension_draft.h"
#include "tension/tension_file.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

namespace cli
{
namespace
{

void Complain(const std::string& utf8)
{
    WriteConsoleText(stderr, "vekcfg: " + utf8 + "\n");
}

// Output that cannot be written (a full disk, a closed pipe) is a failure,
// never a success.
int StandardOutputFailed(int error)
{
    Complain("cannot write to standard output: " +
             Utf8FromNative(std::strerror(error != 0 ? error : EIO)));
    return kExitTrouble;
}

int Print(const std::string& utf8, int status)
{
    errno = 0;
    return WriteConsoleText(stdout, utf8) ? status : StandardOutputFailed(errno);
}

// The device every decode of music goes through; its failure is reported.
bool StartSoundDeviceOrComplain(sound::CSound& device)
{
    std::string reason;
    if (StartSoundDevice(device, &reason))
        return true;
    Complain(reason);
    return false;
}

int UsageError(const std::string& error)
{
    Complain(error);
    WriteConsoleText(stderr, UsageText());
    return kExitTrouble;
}

bool WriteWholeFile(const std::string& path, const std::string& bytes, std::string* error)
{
    errno = 0;
    std::FILE* file = std::fopen(path.c_str(), "wb");
    bool written =
        file != nullptr && std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
    const int writeError = errno;
    if (file != nullptr && std::fclose(file) != 0)
        written = false;
    if (!written)
        *error = "cannot write \"" + Utf8FromNative(path) +
                 "\": " + Utf8FromNative(std::strerror(writeError != 0 ? writeError : EIO));
    return written;
}

int Check(const Invocation& invocation)
{
    sound::CSound device;
    if (!StartSoundDeviceOrComplain(device))
        return kExitTrouble;
    const CheckRun run = RunCheck(invocation.musicPath, invocation.tensionPath,
                                  invocation.details || !invocation.svgPath.empty());
    std::string out = run.message;
    if (invocation.details)
        out += DetailsText(run.result, run.figures);
    const int status = Print(
        out, run.result == tension::MusicCheckResult::Accepted ? kExitSuccess : kExitCheckFailed);
    if (invocation.svgPath.empty() || status == kExitTrouble)
        return status;
    if (!run.figures.hasTimeline)
    {
        std::string complaint = "\"";
        complaint += Utf8FromNative(invocation.svgPath);
        complaint += "\" not written: ";
        complaint += run.figures.musicOpened ? "the tension file could not be read"
                                             : "the music could not be opened";
        Complain(complaint);
        return status;
    }
    std::string error;
    if (!WriteWholeFile(invocation.svgPath, TimelineSvg(run.result, run.figures), &error))
    {
        Complain(error);
        return kExitTrouble;
    }
    return status;
}

bool LoadSettings(const Invocation& invocation, config::CSaveConfig& record, std::string* path,
                  std::uint32_t* version)
{
    std::string error;
    *path = invocation.settingsPath;
    if (path->empty() && !DefaultSettingsPath(path, &error))
    {
        UsageError(error);
        return false;
    }
    if (!LoadSettingsFile(*path, record, version, &error))
    {
        Complain(error);
        return false;
    }
    return true;
}

int CheckConfig(const Invocation& invocation)
{
    config::CSaveConfig record;
    std::string path;
    std::uint32_t version = 0;
    if (!LoadSettings(invocation, record, &path, &version))
        return kExitTrouble;
    sound::CSound device;
    if (!StartSoundDeviceOrComplain(device))
        return kExitTrouble;
    std::vector<RowCheck> rows;
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        const config::UserBgmRow& stored = record.UserBgm()->rows[row];
        RowCheck check;
        check.row = row + 1;
        check.music = config::FieldText(stored.musicPath);
        if (check.music.empty())
            continue;
        check.tension = config::FieldText(stored.tensionPath);
        rows.push_back(std::move(check));
    }
    bool allPassed = true;
    bool printed = true;
    CheckRows(rows, invocation.jobs > 0 ? invocation.jobs : DefaultJobs(),
              [&allPassed, &printed](const RowCheck& checked)
              {
                  allPassed = allPassed && checked.result == tension::MusicCheckResult::Accepted;
                  printed = printed &&
                            WriteConsoleText(stdout, ConfigRowLine(checked.row,
                                                                   Utf8FromCp932(checked.music),
                                                                   Utf8FromCp932(checked.tension),
                                                                   Utf8FromCp932(checked.message)));
              });
    if (!printed)
        return StandardOutputFailed(EIO);
    return allPassed ? kExitSuccess : kExitCheckFailed;
}

int Show(const Invocation& invocation)
{
    config::CSaveConfig record;
    std::string path;
    std::uint32_t version = 0;
    if (!LoadSettings(invocation, record, &path, &version))
        return kExitTrouble;
    const Setting settings = DescribeSettings(record, path, version);
    return Print(invocation.json ? SettingsJson(settings) : SettingsText(settings), kExitSuccess);
}

// Only a file that is a settings file as this tool writes it is changed;
// every value is checked before the save, which is the tool's own: it
// replaces the file in one step or not at all.
int ChangeSettings(const Invocation& invocation, const std::vector<SettingChange>& given)
{
    config::CSaveConfig record;
    std::string path;
    std::uint32_t version = 0;
    if (!LoadSettings(invocation, record, &path, &version))
        return kExitTrouble;
    std::string refusal;
    if (!ApplyChanges(record, given, &refusal))
    {
        Complain(refusal);
        return kExitTrouble;
    }
    if (!record.SaveToPath(path.c_str()))
    {
        Complain("cannot save the settings file \"" + Utf8FromNative(path) +
                 "\"; it is left as it was");
        return kExitTrouble;
    }
    return kExitSuccess;
}

int Set(const Invocation& invocation)
{
    std::vector<SettingChange> changes;
    for (const std::string& assignment : invocation.assignments)
    {
        SettingChange change;
        ReadAssignment(assignment, &change);
        changes.push_back(std::move(change));
    }
    return ChangeSettings(invocation, changes);
}

int Apply(const Invocation& invocation)
{
    std::string bytes;
    const bool standardInput = invocation.jsonPath == "-";
    errno = 0;
    std::FILE* file = standardInput ? stdin : std::fopen(invocation.jsonPath.c_str(), "rb");
    bool tooLarge = false;
    const bool read = file != nullptr && ReadBounded(file, kMaxJsonBytes, &bytes, &tooLarge);
    const int readError = errno;
    if (file != nullptr && !standardInput)
        std::fclose(file);
    const std::string shown = standardInput
                                  ? std::string("standard input")
                                  : std::string("\"") + Utf8FromNative(invocation.jsonPath) + "\"";
    if (tooLarge)
    {
        Complain("the settings tree " + shown + " is larger than " +
                 std::to_string(kMaxJsonBytes >> 20) + " MiB, more than any settings file holds");
        return kExitTrouble;
    }
    if (!read)
    {
        Complain("cannot read the settings tree " + shown + ": " +
                 Utf8FromNative(std::strerror(readError != 0 ? readError : EIO)));
        return kExitTrouble;
    }
    Json tree;
    std::string error;
    if (!ReadJson(bytes, &tree, &error))
    {
        Complain("the settings tree " + shown + " is refused: " + error);
        return kExitTrouble;
    }
    std::vector<SettingChange> changes;
    if (!ChangesFromJson(tree, &changes, &error))
    {
        Complain(error);
        return kExitTrouble;
    }
    return ChangeSettings(invocation, changes);
}

// A file name in the tension file's code page; a character it has no form
// for becomes "_".
std::string Cp932Name(const std::string& utf8)
{
    std::string name;
    for (std::size_t i = 0; i < utf8.size();)
    {
        const auto lead = static_cast<unsigned char>(utf8[i]);
        const std::size_t size = lead < 0x80 ? 1 : lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : 2;
        std::string character;
        name += Cp932FromUtf8(utf8.substr(i, size), &character) ? character : "_";
        i += size;
    }
    return name;
}

int Draft(const Invocation& invocation)
{
    // One decode gives the music's length and its loudness, measured while
    // it decodes; music the check cannot open gets the check's message.
    sound::MusicMeasure music;
    if (!sound::MeasureMusic(invocation.musicPath.c_str(), &music))
    {
        WriteConsoleText(stderr, Utf8FromCp932(tension::kMusicUnreadableMessage) + "\n");
        return kExitCheckFailed;
    }
    const float length = music.length;
    const std::string text =
        tension::DraftTension(tension::DraftName(Cp932Name(Utf8FromNative(invocation.musicPath))),
                              length, music.loudness);
    // What the check makes of the draft: music too short or too long gets
    // the check's own messages.
    tension::CTensionFile draft;
    tension::CTextString log;
    if (!draft.ParseForLength(length, text.c_str(), ':', ';', &log))
    {
        WriteConsoleText(stderr, Utf8FromCp932(log.CStr()));
        return kExitCheckFailed;
    }
    if (invocation.outputPath.empty())
    {
        errno = 0;
        const bool written = std::fwrite(text.data(), 1, text.size(), stdout) == text.size();
        if (std::fflush(stdout) == 0 && written)
            return kExitSuccess;
        return StandardOutputFailed(errno);
    }
    if (!base::WriteFileAtomically(invocation.outputPath.c_str(), text.data(), text.size()))
    {
        Complain("cannot write \"" + Utf8FromNative(invocation.outputPath) + "\"");
        return kExitTrouble;
    }
    return kExitSuccess;
}

} // namespace

int RunVekcfg(int argc, const char* const* argv)
{
    const ParsedCommandLine parsed =
        ParseCommandLine(std::vector<std::string>(argv, argv + (argc > 0 ? argc : 0)));
    if (!parsed.valid)
        return UsageError(parsed.error);
    Invocation invocation = parsed.invocation;
    // Paths are opened as the system's functions take them.
    for (std::string* path :
         {&invocation.musicPath, &invocation.tensionPath, &invocation.svgPath,
          &invocation.settingsPath, &invocation.jsonPath, &invocation.outputPath})
    {
        const std::string given = *path;
        if (!NativeFromUtf8(given, path))
            return UsageError("the path \"" + given +
                              "\" has a character the system's code page has no form for");
    }
    switch (invocation.command)
    {
    case Command::Help:
        return Print(HelpText(), kExitSuccess);
    case Command::Version:
        return Print("vekcfg " + std::string(kVersion) + "\n", kExitSuccess);
    case Command::Check:
        return Check(invocation);
    case Command::CheckConfig:
        return CheckConfig(invocation);
    case Command::Show:
        return Show(invocation);
    case Command::Set:
        return Set(invocation);
    case Command::Apply:
        return Apply(invocation);
    case Command::Draft:
        return Draft(invocation);
    }
    return kExitTrouble;
}

} // namespace cli
