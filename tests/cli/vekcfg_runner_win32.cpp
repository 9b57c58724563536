#include "base/win32.h"
#include "tests/cli/vekcfg_runner.h"

#include <fstream>
#include <iterator>

namespace cli_testing
{
namespace
{

std::string Program()
{
    char path[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, path, sizeof path);
    const std::string self(path);
    return self.substr(0, self.find_last_of('\\') + 1) + "vekcfg.exe";
}

// The quoting the C runtime undoes when it splits a command line.
std::string Quoted(const std::string& argument)
{
    std::string quoted = "\"";
    std::size_t backslashes = 0;
    for (const char c : argument)
    {
        if (c == '\\')
        {
            ++backslashes;
            continue;
        }
        quoted.append(c == '"' ? backslashes * 2 + 1 : backslashes, '\\');
        backslashes = 0;
        quoted += c;
    }
    quoted.append(backslashes * 2, '\\');
    return quoted + "\"";
}

HANDLE OutputFile(const std::string& path)
{
    SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
    return CreateFileA(path.c_str(), GENERIC_WRITE, FILE_SHARE_READ, &inheritable, CREATE_ALWAYS,
                       FILE_ATTRIBUTE_NORMAL, nullptr);
}

// What the program printed in the console's code page, as UTF-8 with LF.
std::string Utf8Contents(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    std::string bytes{std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
    UINT codePage = GetConsoleOutputCP();
    if (codePage == 0)
        codePage = GetACP();
    std::wstring wide(bytes.size(), L'\0');
    wide.resize(std::size_t(MultiByteToWideChar(codePage, 0, bytes.data(), int(bytes.size()),
                                                wide.data(), int(wide.size()))));
    std::string utf8(wide.size() * 3, '\0');
    utf8.resize(std::size_t(WideCharToMultiByte(CP_UTF8, 0, wide.data(), int(wide.size()),
                                                utf8.data(), int(utf8.size()), nullptr, nullptr)));
    std::string lines;
    for (std::size_t i = 0; i < utf8.size(); ++i)
    {
        if (!(utf8[i] == '\r' && i + 1 < utf8.size() && utf8[i + 1] == '\n'))
            lines += utf8[i];
    }
    return lines;
}

} // namespace

ProgramRun RunVekcfg(const std::vector<std::string>& arguments, const std::string& folder)
{
    std::string command = Quoted(Program());
    for (const std::string& argument : arguments)
        command += " " + Quoted(argument);
    const std::string outPath = folder + "\\.stdout";
    const std::string errPath = folder + "\\.stderr";

    ProgramRun run;
    HANDLE out = OutputFile(outPath);
    HANDLE err = OutputFile(errPath);
    STARTUPINFOA startup{};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdInput = INVALID_HANDLE_VALUE;
    startup.hStdOutput = out;
    startup.hStdError = err;
    PROCESS_INFORMATION process{};
    if (CreateProcessA(nullptr, command.data(), nullptr, nullptr, TRUE, 0, nullptr, folder.c_str(),
                       &startup, &process))
    {
        WaitForSingleObject(process.hProcess, 60000);
        DWORD exitCode = 0;
        if (GetExitCodeProcess(process.hProcess, &exitCode))
            run.exitCode = static_cast<int>(exitCode);
        CloseHandle(process.hThread);
        CloseHandle(process.hProcess);
    }
    CloseHandle(out);
    CloseHandle(err);
    run.out = Utf8Contents(outPath);
    run.err = Utf8Contents(errPath);
    DeleteFileA(outPath.c_str());
    DeleteFileA(errPath.c_str());
    return run;
}

} // namespace cli_testing
