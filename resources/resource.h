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
