// The Replay page: whether replays are saved, and the lock of each of the
// thirty kept replays.
#include "app/config_application.h"
#include "dialog/page_controls.h"
#include "resources/resource.h"

namespace
{
// The lock box of replay n (1 to 30) is IDC_SAVE_REPLAYS + n.
constexpr int LockBoxId(int index)
{
    return IDC_SAVE_REPLAYS + 1 + index;
}
} // namespace

bool CConfigApplication::InitReplayPage()
{
    const HWND page = pages_[kReplayPageIndex].window;
    const config::ConfigReplay* replay = record_->Replay();
    dialog::ShowCheck(page, IDC_SAVE_REPLAYS, replay->saveReplays != 0);
    for (int index = 0; index < config::kReplayCount; ++index)
        dialog::ShowCheck(page, LockBoxId(index), replay->replayLock[index] != 0);
    return true;
}

LRESULT CConfigApplication::OnReplayPage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return FALSE;
    if (HIWORD(wParam) != BN_CLICKED)
        return TRUE;
    // The locks do not depend on リプレイを保存する: they change either way.
    config::ConfigReplay* replay = record_->Replay();
    const int id = LOWORD(wParam);
    if (id == IDC_SAVE_REPLAYS)
        replay->saveReplays = dialog::CheckValue(page, id);
    else if (id >= LockBoxId(0) && id < LockBoxId(config::kReplayCount))
        replay->replayLock[id - LockBoxId(0)] = dialog::CheckValue(page, id);
    return TRUE;
}
