// The Game page: game options, the three volumes and the game's choices.
#include "app/config_application.h"
#include "config/field_table.h"
#include "config/volume.h"
#include "dialog/page_controls.h"
#include "resources/resource.h"

#include <commctrl.h>

namespace
{

struct VolumeSlider
{
    int id;
    std::int32_t config::ConfigGame::*field;
};

const VolumeSlider kVolumeSliders[] = {
    {IDC_BGM_VOLUME, &config::ConfigGame::bgmVolume},
    {IDC_SE_VOLUME, &config::ConfigGame::seVolume},
    {IDC_VOICE_VOLUME, &config::ConfigGame::voiceVolume},
};
} // namespace

bool CConfigApplication::InitGamePage()
{
    const HWND page = pages_[kGamePageIndex].window;
    const config::ConfigGame* game = record_->Game();
    dialog::ShowCheck(page, IDC_VOICE_PLAYBACK, game->voicePlayback != 0);
    dialog::ShowCheck(page, IDC_PAD_VIBRATION, game->padVibration != 0);
    dialog::ShowCheck(page, IDC_SCREEN_SHAKE, game->screenShake != 0);
    dialog::ShowCheck(page, IDC_CAPTURE_ENABLED, game->captureEnabled != 0);

    // The range travels as two 16-bit words: the low one is -3000 (0xF448).
    const LPARAM range = MAKELPARAM(static_cast<WORD>(config::kSliderMinimumVolume), 0);
    for (const VolumeSlider& slider : kVolumeSliders)
    {
        const HWND bar = GetDlgItem(page, slider.id);
        SendMessageW(bar, TBM_SETLINESIZE, 0, 10);
        SendMessageW(bar, TBM_SETRANGE, TRUE, range);
        // A stored silence (-10000) lies below the range and shows as its
        // left end; the field keeps it until a slider moves.
        SendMessageW(bar, TBM_SETPOS, TRUE, game->*slider.field);
    }

    dialog::FillChoices(page, IDC_RADAR_TYPE, config::kRadarTypeNames, game->radarType);
    dialog::FillChoices(page, IDC_ARCADE_DIFFICULTY, config::kArcadeDifficultyNames,
                        game->arcadeDifficulty);
    dialog::FillChoices(page, IDC_GUARD_CORRECTION, config::kGuardCorrectionNames,
                        game->guardCorrection);
    dialog::FillChoices(page, IDC_LOCK_ON_TYPE, config::kLockOnTypeNames, game->lockOnType);
    dialog::FillChoices(page, IDC_CAMERA_POSITION, config::kCameraPositionNames,
                        game->cameraPosition);
    dialog::FillChoices(page, IDC_CAPTURE_SIZE, config::kResolutionNames, game->captureSize);
    return true;
}

LRESULT CConfigApplication::OnGamePage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    config::ConfigGame* game = record_->Game();
    if (message == WM_HSCROLL)
    {
        // Whichever slider moved, all three volumes are taken afresh.
        for (const VolumeSlider& slider : kVolumeSliders)
        {
            const auto position =
                static_cast<std::int32_t>(SendDlgItemMessageW(page, slider.id, TBM_GETPOS, 0, 0));
            game->*slider.field = config::VolumeAtSliderPosition(position);
        }
        return TRUE;
    }
    if (message != WM_COMMAND)
        return FALSE;

    const int id = LOWORD(wParam);
    switch (HIWORD(wParam))
    {
    case BN_CLICKED:
        if (id == IDC_PAD_VIBRATION)
            game->padVibration = dialog::CheckValue(page, id);
        else if (id == IDC_SCREEN_SHAKE)
            game->screenShake = dialog::CheckValue(page, id);
        else if (id == IDC_VOICE_PLAYBACK)
            game->voicePlayback = dialog::CheckValue(page, id);
        else if (id == IDC_CAPTURE_ENABLED)
            game->captureEnabled = dialog::CheckValue(page, id);
        break;
    case CBN_SELCHANGE:
        if (id == IDC_RADAR_TYPE)
            dialog::StoreChoice(page, id, &game->radarType);
        else if (id == IDC_ARCADE_DIFFICULTY)
            dialog::StoreChoice(page, id, &game->arcadeDifficulty);
        else if (id == IDC_GUARD_CORRECTION)
            dialog::StoreChoice(page, id, &game->guardCorrection);
        else if (id == IDC_CAMERA_POSITION)
            dialog::StoreChoice(page, id, &game->cameraPosition);
        else if (id == IDC_LOCK_ON_TYPE)
            dialog::StoreChoice(page, id, &game->lockOnType);
        else if (id == IDC_CAPTURE_SIZE)
            dialog::StoreChoice(page, id, &game->captureSize);
        break;
    }
    return TRUE;
}
