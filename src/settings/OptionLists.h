#pragma once

#include <QString>

#include <array>

// The entries of the settings window's drop-down lists, in their fixed order: the index
// of an entry is what the configuration file stores and what the command line carries.

inline constexpr std::array<const char*, 14> kGameTypeEntries = {
    "Automatic (Don't override)",
    "Commavid extra RAM",
    "8K Superchip",
    "8K Parker Brothers",
    "8K Tigervision",
    "8K Decathlon & Robot Tank",
    "16K Superchip",
    "16K M-Network",
    "32K Superchip",
    "8K Atari -- banks swapped",
    "Spectravideo Compumate",
    "32K - 512K Extended Tigervision",
    "8k UA Ltd.",
    "64K Homestar Runner / Ormsby",
};

inline constexpr std::array<const char*, 9> kVideoModeEntries = {
    "Mode 0 -- 400x300 default",
    "Mode 1 -- 320x240",
    "Mode 2 -- 320x200",
    "Mode 3 -- 800x600 scanline/interlaced",
    "Mode 4 -- 640x480 scanline/interlaced",
    "Mode 5 -- 640x400 scanline/interlaced",
    "Mode 6 -- 800x600 double scanline",
    "Mode 7 -- 640x480 double scanline",
    "Mode 8 -- 640x400 double scanline",
};

inline constexpr std::array<const char*, 13> kControllerEntries = {
    "AutoDetect",
    "Joystick",
    "Paddle Controller",
    "Keypad",
    "Driving Controller",
    "LightGun",
    "CompuMate Keyboard",
    "Kid Vid Tape Player",
    "Mindlink Controller",
    "ST Mouse / CX-80 Trak-Ball",
    "CX-22 Trak-Ball",
    "Amiga Mouse",
    "No Controller Connnected",
};
