#include "cli/row_checks.h"

#include <algorithm>
#include <condition_variable>
#include <mutex>
#include <system_error>
#include <thread>

namespace cli
{
namespace
{

void Check(RowCheck& row)
{
    tension::CTextString message;
    row.result = tension::CheckMusicRow(row.music.c_str(), row.tension.c_str(), &message);
    row.message = message.CStr();
}

} // namespace

int DefaultJobs()
{
    const unsigned cores = std::thread::hardware_concurrency();
    return cores > 0 ? static_cast<int>(cores) : 1;
}

void CheckRows(std::vector<RowCheck>& rows, int jobs,
               const std::function<void(const RowCheck&)>& report)
{
    const std::size_t workers =
        std::min<std::size_t>(rows.size(), static_cast<std::size_t>(jobs > 0 ? jobs : 1));
    if (workers <= 1)
    {
        for (RowCheck& row : rows)
        {
            Check(row);
            report(row);
        }
        return;
    }

    std::mutex lock;
    std::condition_variable finished;
    std::vector<bool> done(rows.size(), false);
    std::size_t next = 0;
    const auto work = [&]
    {
        while (true)
        {
            std::size_t mine;
            {
                const std::lock_guard<std::mutex> guard(lock);
                if (next == rows.size())
                    return;
                mine = next++;
            }
            Check(rows[mine]);
            {
                const std::lock_guard<std::mutex> guard(lock);
                done[mine] = true;
            }
            finished.notify_one();
        }
    };

    std::vector<std::thread> threads;
    for (std::size_t i = 0; i < workers; ++i)
    {
        try
        {
            threads.emplace_back(work);
        }
        catch (const std::system_error&)
        {
            break;
        }
    }
    // Without a thread of its own, the calling thread does the work.
    if (threads.empty())
        work();

    for (std::size_t i = 0; i < rows.size(); ++i)
    {
        {
            std::unique_lock<std::mutex> guard(lock);
            finished.wait(guard, [&] { return done[i]; });
        }
        report(rows[i]);
    }
    for (std::thread& thread : threads)
        thread.join();
}

} // namespace cli
