// The simulated handset's auxiliary display: one file of the device root holds its frame,
// written whole by the display's program (mmi_open_fb1) and read by the console.
// Format: the line "FTXFB1 <width> <height> <on>\n", then width x height pixels, 4 bytes
// each (0x00RRGGBB, little-endian), row by row.
#pragma once

#include <stdint.h>

#include <string>
#include <vector>

namespace ftxhost {

inline constexpr const char *kAuxFbDevicePath = "/sim/fb1";
inline constexpr int kAuxFbMaxSide = 4096;
// The panel's size when sim/device.ini does not give one ([aux_screen] width, height).
inline constexpr int kAuxFbDefaultWidth = 240;
inline constexpr int kAuxFbDefaultHeight = 320;

struct AuxFrame {
    int width = 0;
    int height = 0;
    bool on = false;
    std::vector<uint32_t> pixels;
};

// A frame of one colour (black and off when on is false).
AuxFrame aux_fb_plain(int width, int height, bool on, uint32_t colour);
// The file's bytes for a frame, and back; parse answers -1 for anything but a whole frame
// of a sane size.
std::string aux_fb_format(const AuxFrame &f);
int aux_fb_parse(const std::string &bytes, AuxFrame *f);
// Writes the file at a host path whole (a neighbour renamed over it); 0 or -1.
int aux_fb_write(const std::string &hostPath, const AuxFrame &f);
// Reads the file at a host path; -1 when it is missing or not a frame.
int aux_fb_read(const std::string &hostPath, AuxFrame *f);

}  // namespace ftxhost
