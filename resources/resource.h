#pragma once

// Every resource and control identifier of the tool, one range per dialog.

// Main dialog.
#define IDD_MAIN 500
#define IDC_MAIN_TAB 510
#define IDI_APP 113

// Tab pages, in the order of the main tab, and the key sub-pages.
#define IDD_GRAPHICS_PAGE 1000
#define IDD_GAME_PAGE 2000
#define IDD_NETWORK_PAGE 3000
#define IDD_REPLAY_PAGE 6000
#define IDD_USER_MUSIC_PAGE 7000
#define IDD_KEY_CONFIG_PAGE 4000
#define IDD_RADIO_CHAT_PAGE 5000
#define IDD_KEYBOARD_PAGE 4100
#define IDD_PAD_PAGE 4200
#define IDC_KEY_TAB 4010

// IP entry dialog.
#define IDD_IP_ENTRY 114

// Keyboard sub-page: action i (0 to 23) has its edit at
// IDC_KEYBOARD_EDIT_FIRST + i and its label at IDC_KEYBOARD_LABEL_FIRST + i.
#define IDC_KEYBOARD_EDIT_FIRST 4110
#define IDC_KEYBOARD_LABEL_FIRST 4134
#define IDC_KEYBOARD_RESET 4190

// Controller sub-page: the same per action, from IDC_PAD_EDIT_FIRST and
// IDC_PAD_LABEL_FIRST.
#define IDC_PAD_EDIT_FIRST 4210
#define IDC_PAD_LABEL_FIRST 4234
#define IDC_PAD_DEVICE_LABEL 4261
#define IDC_PAD_DEVICE 4262
#define IDC_PAD_RESET 4290
#define IDC_PAD_PLAYER 4291
#define IDC_PAD_PLAYER_LABEL 4292
