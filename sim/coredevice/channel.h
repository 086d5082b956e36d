// Internal view of the PC command channel: its limits, and for the file operations the
// reply of the command being served on this thread.
#pragma once

#include <stddef.h>

namespace ftxsim {

// Clients connected at once; further connections are accepted and closed at once.
constexpr size_t kChannelMaxClients = 64;
// A client that sent nothing and took no reply bytes for this long is closed (scaled by
// FTX_TIME_SCALE like every platform wait).
constexpr int kChannelIdleSeconds = 300;
// Unsent reply bytes past which a client's further lines wait (it is not read) until it
// takes its replies; the same for all clients together. One reply may overshoot either.
constexpr size_t kChannelClientOutMax = 1u << 20;
constexpr size_t kChannelTotalOutMax = 16u << 20;
// When the process has no descriptor left to accept a client, the listener rests until a
// client leaves or this long has passed.
constexpr int kChannelAcceptRetryMs = 100;

struct ChannelReply {
    char *buf;
    size_t size;
    long length;  // bytes to send, or -1 for the text's length
};

// The reply of the command the calling thread is serving, or null outside a command.
ChannelReply *channel_current_reply();

}  // namespace ftxsim
