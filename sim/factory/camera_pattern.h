// The simulated cameras' picture: a moving test pattern, different for each camera.
#pragma once

// Largest side of a frame the cameras give.
#define SIM_CAMERA_MAX_SIDE 4096

namespace ftxsim {

// Draws what camera `id` sees `ms` milliseconds after its start into argb: w x h pixels of
// 0x00RRGGBB, row after row. The back camera (0) shows upright colour bars moving right, the
// front camera (1) warm bands moving down, the second back camera (2) cool diagonal stripes;
// higher ids repeat them. A band crosses the frame in 4 s at any size. 0, or -1 for no
// buffer, a negative id or time, or a side outside 1..SIM_CAMERA_MAX_SIDE.
int camera_pattern(int id, long long ms, unsigned *argb, int w, int h);

}  // namespace ftxsim
