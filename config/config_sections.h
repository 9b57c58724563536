#pragma once

// The sections of "GameConfig.dat". Each struct's bytes are exactly the
// section's payload in the file, padding included; the game reads the same
// bytes, so every size and offset is pinned below.

#include "base/input_codes.h"

#include <cstddef>
#include <cstdint>

namespace config
{

inline constexpr int kResolutionCount = 12;
inline constexpr int kConnectSlotCount = 24;
inline constexpr int kReplayCount = 30;
inline constexpr int kUserBgmRowCount = 10;
inline constexpr int kPathCapacity = 260;
inline constexpr int kActionCount = input::kActionCount;
inline constexpr int kPlayerCount = 4;
inline constexpr int kRadioChatCount = 12;
inline constexpr int kRadioChatTextCapacity = 40;
inline constexpr int kIdCapacity = 33;

// An address of four octet strings: "000".."255" ("%3.3d") or "*" for any.
struct IpEntry
{
    char octets[4][4];
};

struct ConfigGraphics
{
    std::uint8_t screenSize;
    std::uint8_t padding1[3];
    std::uint32_t fullScreen;
    std::uint32_t showMovie;
    std::uint8_t hdrLevel;
    std::uint8_t padding13[3];
    std::uint32_t trailQuality;
};

struct ConfigGame
{
    std::uint32_t screenShake;
    std::uint32_t padVibration;
    std::int32_t bgmVolume;
    std::int32_t seVolume;
    std::int32_t voiceVolume;
    std::uint32_t voicePlayback;
    std::uint32_t lockOnType;
    std::uint8_t radarType;
    std::uint8_t cameraPosition;
    std::uint8_t guardCorrection;
    std::uint8_t arcadeDifficulty;
    std::uint32_t captureEnabled;
    std::uint8_t captureSize;
    std::uint8_t padding37[3];
};

// Two-byte alignment for the network section: its u32 fields after the
// address slots lie at offsets the compiler would not choose by itself.
#pragma pack(push, 1)
struct ConfigNetwork
{
    std::uint16_t port;
    std::uint8_t padding2[2];
    std::uint32_t useUpnp;
    std::uint8_t keyResponse;
    char lobbyId[kIdCapacity];
    char directId[kIdCapacity];
    IpEntry connectList[kConnectSlotCount];
    std::uint8_t padding459[1];
    std::uint32_t allowCount;
    std::uint32_t denyCount;
    std::uint32_t playBgm;
};
#pragma pack(pop)

struct ConfigReplay
{
    std::uint32_t saveReplays;
    std::uint32_t replayLock[kReplayCount];
};

struct UserBgmRow
{
    char musicPath[kPathCapacity];
    char tensionPath[kPathCapacity];
};

struct ConfigUserBgm
{
    UserBgmRow rows[kUserBgmRowCount];
};

struct PadConfig
{
    std::uint32_t buttons[kActionCount];
    std::uint8_t device;
    std::uint8_t padding97[3];
};

struct ConfigKeys
{
    std::uint32_t keyboardKeys[kActionCount];
    PadConfig padConfigs[kPlayerCount];
};

struct RadioChatEntry
{
    std::uint8_t notToAll;
    char text[kRadioChatTextCapacity];
};

struct ConfigRadioChat
{
    RadioChatEntry entries[kRadioChatCount];
};

static_assert(sizeof(IpEntry) == 16);

static_assert(sizeof(ConfigGraphics) == 20);
static_assert(offsetof(ConfigGraphics, screenSize) == 0);
static_assert(offsetof(ConfigGraphics, fullScreen) == 4);
static_assert(offsetof(ConfigGraphics, showMovie) == 8);
static_assert(offsetof(ConfigGraphics, hdrLevel) == 12);
static_assert(offsetof(ConfigGraphics, trailQuality) == 16);

static_assert(sizeof(ConfigGame) == 40);
static_assert(offsetof(ConfigGame, screenShake) == 0);
static_assert(offsetof(ConfigGame, padVibration) == 4);
static_assert(offsetof(ConfigGame, bgmVolume) == 8);
static_assert(offsetof(ConfigGame, seVolume) == 12);
static_assert(offsetof(ConfigGame, voiceVolume) == 16);
static_assert(offsetof(ConfigGame, voicePlayback) == 20);
static_assert(offsetof(ConfigGame, lockOnType) == 24);
static_assert(offsetof(ConfigGame, radarType) == 28);
static_assert(offsetof(ConfigGame, cameraPosition) == 29);
static_assert(offsetof(ConfigGame, guardCorrection) == 30);
static_assert(offsetof(ConfigGame, arcadeDifficulty) == 31);
static_assert(offsetof(ConfigGame, captureEnabled) == 32);
static_assert(offsetof(ConfigGame, captureSize) == 36);

static_assert(sizeof(ConfigNetwork) == 472);
static_assert(offsetof(ConfigNetwork, port) == 0);
static_assert(offsetof(ConfigNetwork, useUpnp) == 4);
static_assert(offsetof(ConfigNetwork, keyResponse) == 8);
static_assert(offsetof(ConfigNetwork, lobbyId) == 9);
static_assert(offsetof(ConfigNetwork, directId) == 42);
static_assert(offsetof(ConfigNetwork, connectList) == 75);
static_assert(offsetof(ConfigNetwork, padding459) == 459);
static_assert(offsetof(ConfigNetwork, allowCount) == 460);
static_assert(offsetof(ConfigNetwork, denyCount) == 464);
static_assert(offsetof(ConfigNetwork, playBgm) == 468);

static_assert(sizeof(ConfigReplay) == 124);
static_assert(offsetof(ConfigReplay, replayLock) == 4);

static_assert(sizeof(UserBgmRow) == 520);
static_assert(offsetof(UserBgmRow, tensionPath) == 260);
static_assert(sizeof(ConfigUserBgm) == 5200);

static_assert(sizeof(PadConfig) == 100);
static_assert(offsetof(PadConfig, device) == 96);
static_assert(sizeof(ConfigKeys) == 496);
static_assert(offsetof(ConfigKeys, padConfigs) == 96);

static_assert(sizeof(RadioChatEntry) == 41);
static_assert(offsetof(RadioChatEntry, text) == 1);
static_assert(sizeof(ConfigRadioChat) == 492);

} // namespace config
