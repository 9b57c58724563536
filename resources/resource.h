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

// Network page: the common and lobby settings, the ID for direct connections
// and the three address lists (接続, 許可, 拒否) with their buttons.
#define IDC_NETWORK_LOBBY_ID 3010
#define IDC_NETWORK_PORT 3011
#define IDC_NETWORK_USE_UPNP 3012
#define IDC_NETWORK_DIRECT_ID 3013
#define IDC_NETWORK_PLAY_BGM 3014
#define IDC_NETWORK_KEY_RESPONSE 3016
#define IDC_DENY_DELETE 3017
#define IDC_DENY_ADD 3018
#define IDC_DENY_LIST 3019
#define IDC_ALLOW_DELETE 3020
#define IDC_ALLOW_ADD 3021
#define IDC_ALLOW_LIST 3022
#define IDC_CONNECT_DELETE 3023
#define IDC_CONNECT_LIST 3024
#define IDC_CONNECT_ADD 3025

// IP entry dialog: its four octet fields, left to right.
#define IDD_IP_ENTRY 114
#define IDC_IP_OCTET1 3026
#define IDC_IP_OCTET2 3027
#define IDC_IP_OCTET3 3028
#define IDC_IP_OCTET4 3029

// Graphics page.
#define IDC_SCREEN_SIZE 1010
#define IDC_HDR_LEVEL 1011
#define IDC_FULL_SCREEN 1012
#define IDC_SHOW_MOVIE 1016
#define IDC_TRAIL_QUALITY 1018

// Game page.
#define IDC_PAD_VIBRATION 2010
#define IDC_SCREEN_SHAKE 2011
#define IDC_VOICE_PLAYBACK 2012
#define IDC_BGM_VOLUME 2014
#define IDC_SE_VOLUME 2015
#define IDC_VOICE_VOLUME 2016
#define IDC_RADAR_TYPE 2017
#define IDC_ARCADE_DIFFICULTY 2018
#define IDC_GUARD_CORRECTION 2019
#define IDC_CAMERA_POSITION 2020
#define IDC_LOCK_ON_TYPE 2021
#define IDC_CAPTURE_ENABLED 2025
#define IDC_CAPTURE_SIZE 2026

// Replay page: the lock box of replay n (1 to 30) is IDC_SAVE_REPLAYS + n.
#define IDC_SAVE_REPLAYS 6001

// Radio-chat page: row k (1 to 12), for F1 to F12, has its message edit at
// IDC_RADIO_CHAT_TEXT_FIRST and its 全体 box at IDC_RADIO_CHAT_TO_ALL_FIRST,
// each plus IDC_RADIO_CHAT_ROW_STEP * (k - 1).
#define IDC_RADIO_CHAT_TEXT_FIRST 5011
#define IDC_RADIO_CHAT_TO_ALL_FIRST 5012
#define IDC_RADIO_CHAT_ROW_STEP 10

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

// User music page: row r (0 to 9) has its music path edit at
// IDC_MUSIC_PATH_FIRST, its tension path edit at IDC_TENSION_PATH_FIRST, its
// 参照 button at IDC_MUSIC_BROWSE_FIRST and its チェック button at
// IDC_MUSIC_CHECK_FIRST, each plus IDC_MUSIC_ROW_STEP * r.
#define IDC_MUSIC_PATH_FIRST 7001
#define IDC_TENSION_PATH_FIRST 7002
#define IDC_MUSIC_BROWSE_FIRST 7003
#define IDC_MUSIC_CHECK_FIRST 7004
#define IDC_MUSIC_ROW_STEP 4
