// The PC command channel thread.
#include "adbd_connection/AtThread.h"

#include <pthread.h>
#include <unistd.h>

#include <android/log.h>

#include "adbd_connection/AtCmdTable.h"
#include "adbd_connection/CmdParse.h"
#include "devfs.h"
#include "core/ftx_lib_binding.h"
#include "minigui/minigui.h"
#include "minigui/window.h"
#include "tp_os.h"

namespace {

const char kTag[] = "AtThread";
const char kRestartFile[] = "/cache/Tcp_Restart.ini";

}  // namespace

int AtThreadStart(void) {
    __android_log_print(ANDROID_LOG_DEBUG, kTag, "%s begin", __func__);
    // The library's socket needs the loopback interface up.
    dev_system("toybox ifconfig lo up");
    int rc = Get_libcoredevice_Interface();
    if (rc != 0) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "%s::Get_libcoredevice_Interface fail",
                            __func__);
        return rc;
    }
    if (register_at_procs() != 0) return -1;
    pthread_t thread;
    rc = pthread_create(&thread, nullptr, start_routine, nullptr);
    if (rc == 0) pthread_detach(thread);
    __android_log_print(ANDROID_LOG_DEBUG, kTag, "%s end", __func__);
    return rc;
}

void *start_routine(void *) {
    __android_log_print(ANDROID_LOG_DEBUG, kTag, "%s thread begin,registerAtSocket=%p", __func__,
                        static_cast<void *>(hw::registerAtSocket.get()));
    hw::registerAtSocket();
    hw::registerCommandProcess(AtCommandProcess);
    // Serves until the library ends its loop; the channel is not restarted.
    hw::runSelectLoopMode();
    return nullptr;
}

void *Tcp_Relink_PcServer_Thread(void *arg) {
    tp_os_usleep(1000000);
    PostMessage(static_cast<HWND>(arg), MSG_KEYDOWN, SCANCODE_F4, 0);
    return nullptr;
}

int mmi_start_tcp_relink(HWND hMainWnd) {
    if (dev_access(kRestartFile, R_OK) != 0) return 0;
    pthread_t thread;
    if (pthread_create(&thread, nullptr, Tcp_Relink_PcServer_Thread, hMainWnd) != 0) return 0;
    pthread_detach(thread);
    return 1;
}
