#pragma once

// The music rows of check-config, checked on several threads and reported
// in row order.

#include "tension/music_check.h"

#include <functional>
#include <string>
#include <vector>

namespace cli
{

struct RowCheck
{
    int row = 0;
    // Code page 932, as stored.
    std::string music;
    std::string tension;
    tension::MusicCheckResult result = tension::MusicCheckResult::MusicUnreadable;
    // What the page would show (code page 932).
    std::string message;
};

// Checks every row, `jobs` at once (so at most that many decoded pieces of
// music are in memory), and hands each finished row to `report` on the
// calling thread in row order, as soon as it and every row before it are
// done. With one job everything runs on the calling thread.
void CheckRows(std::vector<RowCheck>& rows, int jobs,
               const std::function<void(const RowCheck&)>& report);

// One job per core the system reports.
int DefaultJobs();

} // namespace cli
