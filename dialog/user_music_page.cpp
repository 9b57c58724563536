// The user music page (BGM): ten pieces of the user's own music, each with
// its tension file. Paths are typed, browsed for or dropped from the shell,
// and every change goes straight into the record; チェック tries a row the
// way the game will load it.
#include "app/config_application.h"
#include "app/system.h"
#include "base/atomic_file.h"
#include "base/window_text_win32.h"
#include "config/fixed_text.h"
#include "dialog/user_music_values.h"
#include "resources/resource.h"
#include "sound/loudness.h"
#include "sound/sound_buffer.h"
#include "tension/music_check.h"
#include "tension/tension_draft.h"

#include <optional>
#include <shellapi.h>
#include <string>

namespace
{

// Description and pattern pairs; the literal's own zero ends the list.
constexpr char kMusicFilter[] = "すべての対応ファイル\0*.wav;*.ogg\0すべてのファイル(*.*)\0*.*\0";
constexpr char kTensionFilter[] = "すべての対応ファイル\0*.txt\0すべてのファイル(*.*)\0*.*\0";

// A path is kept in the system's ANSI code page, the one the game opens it
// with; one that code page cannot hold would reach the game damaged.
constexpr char kPathNotInCodePage[] =
    "このパスには、このシステムの文字コードで表せない文字が含まれているため、"
    "ゲームが開けません。\n別の名前のファイルかフォルダーを選んでください。";

void RefusePath()
{
    base::ShowMessage(nullptr, kPathNotInCodePage, "", MB_OK);
}

// The offer of a draft when a row's tension file is missing.
constexpr char kDraftQuestion[] = "テンションファイルをBGMから作成しますか?";
constexpr char kDraftFailed[] = "テンションファイルを作成できませんでした";

// Sends the edit's messages through `procedure` from now on and shows the
// path; the edit takes files dropped from the shell.
void Subclass(SubclassedEdit& edit, HWND page, int id, WNDPROC procedure, const std::string& path)
{
    edit.controlId = id;
    edit.window = GetDlgItem(page, id);
    if (edit.window == nullptr)
        return;
    // Kept before the new procedure is in place: the first message it sees
    // is passed on to this one.
    edit.previousProcedure =
        reinterpret_cast<WNDPROC>(GetWindowLongPtrW(edit.window, GWLP_WNDPROC));
    SetWindowLongPtrW(edit.window, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(procedure));
    base::SetPathText(edit.window, path);
    DragAcceptFiles(edit.window, TRUE);
}

// The first file of a drop goes into the field and the edit; any further
// ones are ignored. A drop without a file, or of a path the game could not
// open, leaves both as they were.
void TakeDroppedFile(HDROP drop, HWND edit, char (&field)[config::kPathCapacity])
{
    std::wstring path(DragQueryFileW(drop, 0, nullptr, 0), L'\0');
    const bool dropped =
        !path.empty() && DragQueryFileW(drop, 0, path.data(), UINT(path.size() + 1)) != 0;
    DragFinish(drop);
    if (!dropped)
        return;
    const std::optional<std::string> held = base::AnsiFrom(path);
    if (!held)
    {
        RefusePath();
        return;
    }
    config::StoreFieldText(field, config::kPathTextLimit, *held);
    base::SetPathText(edit, *held);
}

// A typed path the game could not open is refused whole: the edit shows the
// stored path again.
void StoreEditText(HWND edit, char (&field)[config::kPathCapacity])
{
    const std::wstring text = base::WindowTextWide(edit);
    // The stored path shown back (at start, or after a refusal) is kept as
    // it is, byte for byte, whatever the code page makes of it.
    if (text == base::WideFromAnsi(config::FieldText(field)))
        return;
    const std::optional<std::string> path = base::AnsiFrom(text);
    if (path)
    {
        config::StoreFieldText(field, config::kPathTextLimit, *path);
        return;
    }
    base::SetPathText(edit, config::FieldText(field));
    // Typing goes on at the end of the path, not before it.
    const int end = GetWindowTextLengthW(edit);
    SendMessageW(edit, EM_SETSEL, end, end);
    RefusePath();
}

// The music file, then at once its tension file. The main dialog stays
// disabled across both dialogs, so that nothing else of the tool can be
// used between them; a cancel keeps what was chosen before it.
void BrowseRow(CSystem& system, config::UserBgmRow& paths, HWND musicEdit, HWND tensionEdit)
{
    const HWND mainDialog = system.GetHwnd();
    EnableWindow(mainDialog, FALSE);
    char music[config::kPathCapacity] = {};
    const CSystem::FileChoice musicChoice =
        system.OpenFileDialog(music, "BGMファイルを開く", kMusicFilter, "wav");
    if (musicChoice != CSystem::FileChoice::Chosen)
    {
        EnableWindow(mainDialog, TRUE);
        if (musicChoice == CSystem::FileChoice::NotInCodePage)
            RefusePath();
        return;
    }
    config::StoreFieldText(paths.musicPath, config::kPathTextLimit, music);
    base::SetPathText(musicEdit, music);

    char tensionFile[config::kPathCapacity] = {};
    const CSystem::FileChoice tensionChoice =
        system.OpenFileDialog(tensionFile, "テンションファイルを開く", kTensionFilter, "txt");
    EnableWindow(mainDialog, TRUE);
    if (tensionChoice == CSystem::FileChoice::NotInCodePage)
        RefusePath();
    if (tensionChoice != CSystem::FileChoice::Chosen)
        return;
    config::StoreFieldText(paths.tensionPath, config::kPathTextLimit, tensionFile);
    base::SetPathText(tensionEdit, tensionFile);
}

// A draft laid on the music, written where nothing stands.
bool WriteDraft(const std::string& musicPath, const std::string& path)
{
    sound::MusicMeasure music;
    if (!sound::MeasureMusic(musicPath.c_str(), &music))
        return false;
    // The path is in the system's code page; the name entry is code page 932.
    const std::string name = tension::DraftName(base::Cp932From(base::WideFromAnsi(musicPath)));
    const std::string text = tension::DraftTension(name, music.length, music.loudness);
    return base::WriteNewFileAtomically(path.c_str(), text.data(), text.size());
}

// Shows the outcome in a plain box. When the tension file is missing, a
// draft from the music is offered; the path of a draft written goes into
// the field as if typed, and the row is checked again.
bool CheckRow(config::UserBgmRow& paths, HWND tensionEdit)
{
    const std::string musicPath = config::FieldText(paths.musicPath);
    const std::string tensionPath = config::FieldText(paths.tensionPath);
    float length = 0.0f;
    tension::CTextString message;
    const tension::MusicCheckResult result =
        tension::CheckMusicRow(musicPath.c_str(), tensionPath.c_str(), &message,
                               [&length](const tension::MusicCheckInspection& seen) {
                                   length = seen.music != nullptr ? seen.music->GetLength() : 0.0f;
                               });
    base::ShowMessage(nullptr, message.CStr(), "", MB_OK);
    if (result == tension::MusicCheckResult::Accepted)
        return true;
    const std::string draft = tension::DraftPathFor(
        musicPath, tensionPath, result != tension::MusicCheckResult::MusicUnreadable, length,
        config::kPathTextLimit);
    if (draft.empty() ||
        base::ShowMessage(nullptr, kDraftQuestion, "", MB_YESNO | MB_ICONQUESTION) != IDYES)
        return false;
    if (!WriteDraft(musicPath, draft))
    {
        base::ShowMessage(nullptr, kDraftFailed, "", MB_OK);
        return false;
    }
    config::StoreFieldText(paths.tensionPath, config::kPathTextLimit, draft);
    base::SetPathText(tensionEdit, draft);
    return CheckRow(paths, tensionEdit);
}

} // namespace

bool CConfigApplication::InitUserMusicPage()
{
    const HWND page = pages_[kUserMusicPageIndex].window;
    const config::ConfigUserBgm* music = record_->UserBgm();
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        const int step = IDC_MUSIC_ROW_STEP * row;
        Subclass(musicEdits_[row], page, IDC_MUSIC_PATH_FIRST + step, procedure_,
                 config::FieldText(music->rows[row].musicPath));
        Subclass(tensionEdits_[row], page, IDC_TENSION_PATH_FIRST + step, procedure_,
                 config::FieldText(music->rows[row].tensionPath));
    }
    return true;
}

LRESULT CConfigApplication::OnUserMusicEdit(HWND edit, UINT message, WPARAM wParam, LPARAM lParam)
{
    config::ConfigUserBgm* music = record_->UserBgm();
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        const bool isMusic = edit == musicEdits_[row].window;
        if (!isMusic && edit != tensionEdits_[row].window)
            continue;
        if (message != WM_DROPFILES)
        {
            const SubclassedEdit& entry = isMusic ? musicEdits_[row] : tensionEdits_[row];
            return CallWindowProcW(entry.previousProcedure, edit, message, wParam, lParam);
        }
        config::UserBgmRow& paths = music->rows[row];
        TakeDroppedFile(reinterpret_cast<HDROP>(wParam), edit,
                        isMusic ? paths.musicPath : paths.tensionPath);
        return 0;
    }
    return 0;
}

LRESULT CConfigApplication::OnUserMusicPage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return FALSE;
    const int id = LOWORD(wParam);
    const std::optional<dialog::MusicControl> control = dialog::MusicControlOf(id);
    if (!control)
        return TRUE;
    const int row = control->row;
    config::UserBgmRow& paths = record_->UserBgm()->rows[row];
    const UINT code = HIWORD(wParam);
    switch (control->column)
    {
    case dialog::MusicColumn::MusicPath:
        if (code == EN_UPDATE)
            StoreEditText(GetDlgItem(page, id), paths.musicPath);
        return TRUE;
    case dialog::MusicColumn::TensionPath:
        if (code == EN_UPDATE)
            StoreEditText(GetDlgItem(page, id), paths.tensionPath);
        return TRUE;
    case dialog::MusicColumn::Browse:
        if (code == BN_CLICKED)
            BrowseRow(*system_, paths, musicEdits_[row].window, tensionEdits_[row].window);
        return TRUE;
    case dialog::MusicColumn::Check:
        if (code != BN_CLICKED)
            return TRUE;
        return CheckRow(paths, tensionEdits_[row].window) ? TRUE : FALSE;
    }
    return TRUE;
}
