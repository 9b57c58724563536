#include "cli/vekcfg.h"

#include "cli/check_report.h"
#include "cli/command_line.h"
#include "cli/encoding.h"
#include "cli/platform.h"
#include "cli/settings_file.h"
#include "cli/settings_report.h"
#include "cli/timeline_svg.h"
#include "config/fixed_text.h"
#include "config/save_config.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

namespace cli
{
namespace
{

void Print(const std::string& utf8)
{
    WriteConsoleText(stdout, utf8);
}

void Complain(const std::string& utf8)
{
    WriteConsoleText(stderr, "vekcfg: " + utf8 + "\n");
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
    std::string reason;
    if (!StartSoundDevice(device, &reason))
    {
        Complain(reason);
        return kExitTrouble;
    }
    const CheckRun run = RunCheck(invocation.musicPath, invocation.tensionPath);
    std::string out = run.message;
    if (invocation.details)
        out += DetailsText(run.result, run.figures);
    Print(out);

    const int status =
        run.result == tension::MusicCheckResult::Accepted ? kExitSuccess : kExitCheckFailed;
    if (invocation.svgPath.empty())
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
    std::string reason;
    if (!StartSoundDevice(device, &reason))
    {
        Complain(reason);
        return kExitTrouble;
    }
    bool allPassed = true;
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        const config::UserBgmRow& stored = record.UserBgm()->rows[row];
        const std::string music = config::FieldText(stored.musicPath);
        if (music.empty())
            continue;
        const std::string tensionPath = config::FieldText(stored.tensionPath);
        tension::CTextString message;
        const tension::MusicCheckResult result =
            tension::CheckMusicRow(music.c_str(), tensionPath.c_str(), &message);
        allPassed = allPassed && result == tension::MusicCheckResult::Accepted;
        Print(ConfigRowLine(row + 1, Utf8FromCp932(music), Utf8FromCp932(tensionPath),
                            Utf8FromCp932(message.CStr())));
    }
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
    Print(invocation.json ? SettingsJson(settings) : SettingsText(settings));
    return kExitSuccess;
}

} // namespace

int RunVekcfg(int argc, const char* const* argv)
{
    const ParsedCommandLine parsed =
        ParseCommandLine(std::vector<std::string>(argv, argv + (argc > 0 ? argc : 0)));
    if (!parsed.valid)
        return UsageError(parsed.error);
    const Invocation& invocation = parsed.invocation;
    switch (invocation.command)
    {
    case Command::Help:
        Print(HelpText());
        return kExitSuccess;
    case Command::Version:
        Print("vekcfg " + std::string(kVersion) + "\n");
        return kExitSuccess;
    case Command::Check:
        return Check(invocation);
    case Command::CheckConfig:
        return CheckConfig(invocation);
    case Command::Show:
        return Show(invocation);
    }
    return kExitTrouble;
}

} // namespace cli
