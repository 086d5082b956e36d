// The Wi-Fi link of the hub: the link picture, the soft-key middle label and the link key.
#pragma once

#include <atomic>

// 1 while the link holds the keys (only the unlock gesture gets through).
extern std::atomic<int> g_bWiFiConnectStatus;
