// The Graphics page: screen size, HDR, trail quality, full screen and movies.
#include "app/config_application.h"
#include "config/field_table.h"
#include "dialog/page_controls.h"
#include "resources/resource.h"

bool CConfigApplication::InitGraphicsPage()
{
    const HWND page = pages_[kGraphicsPageIndex].window;
    const config::ConfigGraphics* graphics = record_->Graphics();
    dialog::FillChoices(page, IDC_SCREEN_SIZE, config::kResolutionNames, graphics->screenSize);
    dialog::FillChoices(page, IDC_HDR_LEVEL, config::kHdrLevelNames, graphics->hdrLevel);
    dialog::FillChoices(page, IDC_TRAIL_QUALITY, config::kTrailQualityNames,
                        graphics->trailQuality);
    dialog::ShowCheck(page, IDC_FULL_SCREEN, graphics->fullScreen != 0);
    dialog::ShowCheck(page, IDC_SHOW_MOVIE, graphics->showMovie != 0);
    return true;
}

LRESULT CConfigApplication::OnGraphicsPage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return FALSE;
    config::ConfigGraphics* graphics = record_->Graphics();
    const int id = LOWORD(wParam);
    switch (HIWORD(wParam))
    {
    case BN_CLICKED:
        if (id == IDC_FULL_SCREEN)
            graphics->fullScreen = dialog::CheckValue(page, id);
        else if (id == IDC_SHOW_MOVIE)
            graphics->showMovie = dialog::CheckValue(page, id);
        break;
    case CBN_SELCHANGE:
        if (id == IDC_SCREEN_SIZE)
            dialog::StoreChoice(page, id, &graphics->screenSize);
        else if (id == IDC_HDR_LEVEL)
            dialog::StoreChoice(page, id, &graphics->hdrLevel);
        else if (id == IDC_TRAIL_QUALITY)
            dialog::StoreChoice(page, id, &graphics->trailQuality);
        break;
    }
    return TRUE;
}
