// Turning a device shell line into one the host's /bin/sh may run: every path is taken
// inside the device root, every command is a tool of the build or a harmless shell builtin,
// and nothing inside the device root is ever executed.
#pragma once

#include <functional>
#include <string>

namespace ftxhost {

struct ShellContext {
    std::string root;     // host folder of the device root, no trailing slash
    std::string toolDir;  // host folder of the build's handset tools
    // True when the build has a handset tool of that name.
    std::function<bool(const std::string &name)> hasTool;
    // True when the device root holds that (normalised) device path.
    std::function<bool(const std::string &devicePath)> deviceHas;
};

// Rewrites line for the host shell. Returns 0 with the line in *out, or -1 with the
// reason in *why, and then nothing may run. Words are re-emitted single-quoted, so the
// host shell only sees literal words, operators and redirections.
int shell_prepare(const std::string &line, const ShellContext &ctx, std::string *out,
                  std::string *why);

// "." and ".." resolved, never above "/"; a relative path is taken from "/" (the handset's
// working directory). A trailing slash is kept.
std::string normalise_device_path(const std::string &path);

}  // namespace ftxhost
