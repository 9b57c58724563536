// The main dialog's own handling: save, the closing questions and the tab.
#include "app/config_application.h"
#include "base/window_text_win32.h"
#include "resources/resource.h"

#include <commctrl.h>

LRESULT CConfigApplication::OnMainDialog(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam)
{
    switch (message)
    {
    case WM_NOTIFY:
        return OnMainTabNotify(lParam);
    case WM_CLOSE:
        ConfirmClose(dialog, "コンフィグツールを閉じますか？");
        return TRUE;
    case WM_DESTROY:
        PostQuitMessage(0);
        return TRUE;
    case WM_COMMAND:
        switch (LOWORD(wParam))
        {
        case IDOK:
            return OnSave(dialog);
        case IDCANCEL:
            ConfirmClose(dialog,
                         "保存されていないデータは失われます\nコンフィグツールを閉じますか？");
            return TRUE;
        default:
            return TRUE;
        }
    default:
        return FALSE;
    }
}

LRESULT CConfigApplication::OnSave(HWND dialog)
{
    if (!record_->Save())
    {
        // The dialog stays open with every value, so saving can be tried again.
        base::ShowMessage(dialog, "保存に失敗しました", "エラー", MB_OK);
        return FALSE;
    }
    ConfirmClose(dialog, "保存されました\nコンフィグツールを閉じますか？");
    return TRUE;
}

void CConfigApplication::ConfirmClose(HWND dialog, const char* question)
{
    if (base::ShowMessage(dialog, question, "終了確認", MB_YESNO | MB_ICONQUESTION) == IDYES)
        DestroyWindow(dialog);
}
