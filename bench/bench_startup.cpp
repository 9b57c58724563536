// How long the tool takes to come up, against a program that creates the
// same dialogs from the same templates and does nothing else.
//
// Both programs time themselves from their entry to the first pass of their
// message loop (the dialog shown and every page filled), write the seconds to
// their standard output and end. They run alternately, each in a fresh
// process with a TEMP of the benchmark's own (so the tool reads and writes
// a settings file there, never the user's); one unmeasured run of each comes
// first. The medians of the runs are compared; the last line is `ratio R`,
// R = the tool's median / the reference's. Target: at most 1.3.
//
// Timed from inside: the tool's loop never waits, so a driver asking Wine
// about its windows would be slowed by it and measure that instead.
#include "base/win32.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

namespace
{

std::string OwnDirectory()
{
    char path[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, path, sizeof path);
    const std::string self(path);
    return self.substr(0, self.find_last_of('\\') + 1);
}

// This process's environment with TEMP replaced, as a CreateProcess block.
std::vector<char> EnvironmentWithTemp(const std::string& temp)
{
    std::vector<char> block;
    char* strings = GetEnvironmentStringsA();
    for (const char* entry = strings; *entry != '\0'; entry += std::strlen(entry) + 1)
    {
        if (_strnicmp(entry, "TEMP=", 5) != 0)
            block.insert(block.end(), entry, entry + std::strlen(entry) + 1);
    }
    FreeEnvironmentStringsA(strings);
    const std::string own = "TEMP=" + temp;
    block.insert(block.end(), own.c_str(), own.c_str() + own.size() + 1);
    block.push_back('\0');
    return block;
}

// Runs `program` to its end and returns the seconds it reported; a negative
// value when it reported none.
double TimedRun(const std::string& program, std::vector<char>& environment)
{
    SECURITY_ATTRIBUTES inherit = {sizeof inherit, nullptr, TRUE};
    HANDLE readEnd = nullptr;
    HANDLE writeEnd = nullptr;
    if (!CreatePipe(&readEnd, &writeEnd, &inherit, 0))
        return -1.0;
    SetHandleInformation(readEnd, HANDLE_FLAG_INHERIT, 0);
    STARTUPINFOA startup = {};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdOutput = writeEnd;
    startup.hStdError = GetStdHandle(STD_ERROR_HANDLE);
    startup.hStdInput = GetStdHandle(STD_INPUT_HANDLE);
    std::string command = "\"" + program + "\"";
    PROCESS_INFORMATION process = {};
    const BOOL started = CreateProcessA(nullptr, command.data(), nullptr, nullptr, TRUE, 0,
                                        environment.data(), nullptr, &startup, &process);
    CloseHandle(writeEnd);
    std::string output;
    if (started)
    {
        char chunk[256];
        DWORD got = 0;
        while (ReadFile(readEnd, chunk, sizeof chunk, &got, nullptr) && got > 0)
            output.append(chunk, got);
        if (WaitForSingleObject(process.hProcess, 30000) != WAIT_OBJECT_0)
            TerminateProcess(process.hProcess, 1);
        CloseHandle(process.hThread);
        CloseHandle(process.hProcess);
    }
    CloseHandle(readEnd);
    char* end = nullptr;
    const double seconds = std::strtod(output.c_str(), &end);
    return end != output.c_str() ? seconds : -1.0;
}

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    const std::size_t middle = values.size() / 2;
    return values.size() % 2 != 0 ? values[middle] : (values[middle - 1] + values[middle]) / 2;
}

} // namespace

int main(int argc, char** argv)
{
    int runs = 9;
    if (argc == 3 && std::strcmp(argv[1], "--runs") == 0)
        runs = std::max(1, std::atoi(argv[2]));

    const std::string tool = OwnDirectory() + "bench_startup_tool.exe";
    const std::string reference = OwnDirectory() + "bench_startup_reference.exe";
    char temp[MAX_PATH] = {};
    GetTempPathA(sizeof temp, temp);
    const std::string root =
        std::string(temp) + "vek-bench-startup-" + std::to_string(GetCurrentProcessId());
    CreateDirectoryA(root.c_str(), nullptr);
    CreateDirectoryA((root + "\\Temp").c_str(), nullptr);
    std::vector<char> environment = EnvironmentWithTemp(root + "\\Temp");

    // The first runs write the settings file and bring the libraries into
    // the file cache; they are not counted.
    if (TimedRun(tool, environment) < 0 || TimedRun(reference, environment) < 0)
    {
        std::fprintf(stderr, "the start-up programs did not report: build bench_startup_tool "
                             "and bench_startup_reference beside this program\n");
        return 2;
    }
    std::vector<double> toolTimes;
    std::vector<double> referenceTimes;
    for (int run = 0; run < runs; ++run)
    {
        const double toolTime = TimedRun(tool, environment);
        const double referenceTime = TimedRun(reference, environment);
        if (toolTime < 0 || referenceTime < 0)
        {
            std::fprintf(stderr, "run %d: a start-up program did not report\n", run + 1);
            return 2;
        }
        toolTimes.push_back(toolTime);
        referenceTimes.push_back(referenceTime);
        std::printf("run %d: tool %.1f ms, reference %.1f ms\n", run + 1, toolTime * 1e3,
                    referenceTime * 1e3);
        std::fflush(stdout);
    }

    DeleteFileA((root + "\\Tolvenik\\VEK\\GameConfig.dat").c_str());
    RemoveDirectoryA((root + "\\Tolvenik\\VEK").c_str());
    RemoveDirectoryA((root + "\\Tolvenik").c_str());
    RemoveDirectoryA((root + "\\Temp").c_str());
    RemoveDirectoryA(root.c_str());

    const double toolMedian = Median(toolTimes);
    const double referenceMedian = Median(referenceTimes);
    std::printf("tool, median of %d: %.1f ms\n", runs, toolMedian * 1e3);
    std::printf("reference, median of %d: %.1f ms\n", runs, referenceMedian * 1e3);
    std::printf("ratio %.2f\n", toolMedian / referenceMedian);
    return 0;
}
