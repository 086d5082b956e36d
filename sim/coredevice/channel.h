// Internal view of the PC command channel for the file operations: the reply of the
// command being served on this thread.
#pragma once

#include <stddef.h>

namespace ftxsim {

struct ChannelReply {
    char *buf;
    size_t size;
    long length;  // bytes to send, or -1 for the text's length
};

// The reply of the command the calling thread is serving, or null outside a command.
ChannelReply *channel_current_reply();

}  // namespace ftxsim
