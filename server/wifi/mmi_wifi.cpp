// The Wi-Fi link: settings, the connection thread, the monitor, the end of the link and the
// PC's Wi-Fi commands. The control connection is shared by the threads, one request at a
// time; the link state and the address are read by the GUI thread.
#include "wifi/mmi_wifi.h"

#include <arpa/inet.h>
#include <errno.h>
#include <netinet/in.h>
#include <pthread.h>
#include <signal.h>
#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <unistd.h>

#include <atomic>
#include <mutex>

#include <android/log.h>
#include <wpa_ctrl.h>

#include "core/ftx_config.h"
#include "core/mmi_thread_stop.h"
#include "devfs.h"
#include "minigui/window.h"
#include "mmi_guithread.h"
#include "tp_os.h"
#include "wifi/mmi_qrcode.h"
#include "wifi/mmi_wifi_reply.h"

#define WIFI_TAG "DVK_FTX"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, WIFI_TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, WIFI_TAG, __VA_ARGS__)

namespace {

const char kCtrlDir[] = "/data/misc/wifi/sockets";
const char kCtrlPath[] = "/data/misc/wifi/sockets/wlan0";
const char kSsidFile[] = "/cache/pv_wifi_switch_ssid.cfg";
const char kInitScript[] = "/system/bin/pv_wifi_init.sh";
const char kCloseScript[] = "/system/bin/pv_wifi_close.sh";
const char kQrPicture[] = "/data/mmi_ip.png";
const int kParams = 12;
const int kReplySize = 2048;

// ---- settings ----

struct Settings {
    char ssid[MMI_WIFI_TEXT_SIZE];
    char keyMgmt[MMI_WIFI_TEXT_SIZE];
    char psk[MMI_WIFI_TEXT_SIZE];
    char defIp[MMI_WIFI_TEXT_SIZE];
    char defGw[MMI_WIFI_TEXT_SIZE];
    int init;
};
std::mutex s_settingsLock;
Settings s_settings = {"DFX_WIFI_TEST",  "WPA-PSK",      "kqmtrel459",
                       "192.168.10.100", "192.168.10.1", 0};

Settings settings() {
    std::lock_guard<std::mutex> lk(s_settingsLock);
    return s_settings;
}

// ---- link state ----

std::atomic<int> WiFiLinkState{0};

// Every change of the link state is logged: the station's engineer follows the link there.
void set_link_state(int state) {
    const int was = WiFiLinkState.exchange(state);
    if (was != state) LOGD("WiFiLinkState %d -> %d", was, state);
}
std::mutex s_addressLock;
char s_address[MMI_WIFI_TEXT_SIZE];

// ---- threads ----

struct Worker {
    const char *name;
    pthread_t tid{};
    bool alive = false;
};
std::mutex s_workersLock;
Worker s_workers[3] = {
    {"WiFiConThread"}, {"wificpt_udpserver_thread"}, {"wifi_status_monitor_thread"}};

int start_worker(int which, void *(*body)(void *), void *arg) {
    std::lock_guard<std::mutex> lk(s_workersLock);
    Worker &w = s_workers[which];
    pthread_attr_t attr;
    pthread_attr_init(&attr);
    pthread_attr_setdetachstate(&attr, PTHREAD_CREATE_DETACHED);
    const int rc = pthread_create(&w.tid, &attr, body, arg);
    pthread_attr_destroy(&attr);
    w.alive = rc == 0;
    return rc == 0 ? 0 : -1;
}

// The calling worker ends (its last step).
void worker_done(int which) {
    std::lock_guard<std::mutex> lk(s_workersLock);
    Worker &w = s_workers[which];
    if (w.alive && pthread_equal(w.tid, pthread_self())) w.alive = false;
}

// Asks a running worker to end (signal 10); true when one ran.
bool stop_worker(int which) {
    std::lock_guard<std::mutex> lk(s_workersLock);
    Worker &w = s_workers[which];
    if (!w.alive) return false;
    pthread_kill(w.tid, SIGUSR1);
    return true;
}

// ---- the control connection ----

std::mutex s_ctrlLock;
struct wpa_ctrl *s_ctrl = nullptr;
std::atomic<int> s_netId{-1};

bool ctrl_open() {
    char path[512], clientDir[512];
    if (dev_path(kCtrlPath, path, sizeof path) != 0) return false;
    std::lock_guard<std::mutex> lk(s_ctrlLock);
    if (s_ctrl != nullptr) wpa_ctrl_close(s_ctrl);
    // The client's own socket beside the supplicant's, as on the handset; the library's
    // default folder when that path is too long for a socket name.
    s_ctrl = dev_path(kCtrlDir, clientDir, sizeof clientDir) == 0 ? wpa_ctrl_open2(path, clientDir)
                                                                  : nullptr;
    if (s_ctrl == nullptr) s_ctrl = wpa_ctrl_open(path);
    return s_ctrl != nullptr;
}

void ctrl_close() {
    std::lock_guard<std::mutex> lk(s_ctrlLock);
    if (s_ctrl != nullptr) wpa_ctrl_close(s_ctrl);
    s_ctrl = nullptr;
}

bool ctrl_exists() {
    std::lock_guard<std::mutex> lk(s_ctrlLock);
    return s_ctrl != nullptr;
}

// One request; the reply (NUL-terminated, its length in *replyLen when asked) in reply.
// False when it could not be made or the supplicant answered FAIL.
bool request(const char *cmd, char *reply, size_t *replyLen = nullptr) {
    std::lock_guard<std::mutex> lk(s_ctrlLock);
    reply[0] = '\0';
    if (replyLen != nullptr) *replyLen = 0;
    if (s_ctrl == nullptr) return false;
    size_t len = kReplySize - 1;
    if (wpa_ctrl_request(s_ctrl, cmd, strlen(cmd), reply, &len, nullptr) != 0) return false;
    reply[len] = '\0';
    if (replyLen != nullptr) *replyLen = len;
    return strncmp(reply, "FAIL", 4) != 0;
}

// ---- the main window ----

void tell_main(UINT message, WPARAM wParam) {
    HWND hWnd = mmi_guithread_window();
    if (hWnd != HWND_INVALID) SendMessage(hWnd, message, wParam, 0);
}
void link_changed() {
    tell_main(MSG_CALLBACK, 0);
}
void bars_refresh() {
    tell_main(MSG_TIMER, 1);
}

// Sleeps unless this thread is asked to end; false when it was.
bool pause_ms(unsigned long ms) {
    return mmi_sleep_unless_stopped(ms * 1000UL);
}

void set_address(const char *text) {
    std::lock_guard<std::mutex> lk(s_addressLock);
    tp_os_strlcpy(s_address, text, sizeof s_address);
}

// The DHCP command of the image, or "" when it has none.
void dhcp_command(char *out, size_t size) {
    out[0] = '\0';
    if (dev_access("/system/bin/dhcpcd", R_OK) == 0 ||
        dev_access("/system/vendor/bin/dhcpcd", R_OK) == 0)
        snprintf(out, size, "/system/bin/dhcpcd wlan0");
    // Only these two count in the end: plain dhcpcd alone is not enough.
    if (dev_access("/system/bin/dhcpcd-6.8.2", R_OK) == 0 ||
        dev_access("/system/vendor/bin/dhcpcd-6.8.2", R_OK) == 0)
        snprintf(out, size, "/system/bin/dhcpcd-6.8.2 wlan0");
    else if (dev_access("/system/bin/dhcptool", R_OK) == 0 ||
             dev_access("/system/vendor/bin/dhcptool", R_OK) == 0)
        snprintf(out, size, "/system/bin/dhcptool wlan0");
    else
        out[0] = '\0';
}

// The end of an attempt that failed before the network was configured.
void give_up_early() {
    ctrl_close();
    dev_system(kCloseScript);
}

// Configures and selects the network: true when every request went through.
bool join(const Settings &s) {
    char reply[kReplySize], cmd[3 * MMI_WIFI_TEXT_SIZE];
    if (!request("ADD_NETWORK", reply)) {
        LOGE("mmi_WiFiConnect::add_network fails.");
        give_up_early();
        return false;
    }
    const int id = mmi_wifi_parse_network_id(reply, strlen(reply));
    s_netId = id;
    snprintf(cmd, sizeof cmd, "SET_NETWORK %d ssid \"%s\"", id, s.ssid);
    if (!request(cmd, reply)) {
        LOGE("set_network ssid fail");
        give_up_early();
        return false;
    }
    snprintf(cmd, sizeof cmd, "SET_NETWORK %d key_mgmt %s", id, s.keyMgmt);
    if (!request(cmd, reply)) {
        LOGE("set_network key_mgmt fail.");
        ctrl_close();
        return false;
    }
    if (strcmp(s.keyMgmt, "NONE") != 0) {
        snprintf(cmd, sizeof cmd, "SET_NETWORK %d psk \"%s\"", id, s.psk);
        if (!request(cmd, reply)) {
            LOGE("set_network psk fail.");
            ctrl_close();
            return false;
        }
    }
    snprintf(cmd, sizeof cmd, "SELECT_NETWORK %d", id);
    if (!request(cmd, reply)) {
        LOGE("select_network fail");
        ctrl_close();
        return false;
    }
    if (!request("RECONNECT", reply)) {
        LOGE("mmi_WiFiConnect::reconnect fails.");
        ctrl_close();
        return false;
    }
    LOGD("%s::reconnect returns: %s", "mmi_WiFiConnect", reply);
    return true;
}

void connection(int showui) {
    const bool quiet = showui == 1;
    LOGD("%s load wlan driver begin.showui = %d", "WiFiConThread", showui);
    dev_system(kInitScript);
    LOGD("%s load wlan driver end.", "WiFiConThread");
    LOGD("%s connect begin.", "WiFiConThread");
    if (mmi_thread_stop_requested()) return;
    if (!ctrl_open()) {
        LOGE("mmi_WiFiConnect::wpa_ctrl_open fails.");
        dev_system(kCloseScript);
        return;
    }
    if (!join(settings())) return;
    char reply[kReplySize];
    for (;;) {
        if (!pause_ms(quiet ? 10000 : 3000)) return;
        char dhcp[64];
        dhcp_command(dhcp, sizeof dhcp);
        if (dhcp[0] == '\0') {
            LOGE("%s dhcpcd or dhcptool not exist.", "WiFiConThread");
            return;
        }
        LOGD("%s::dhcp cmd:%s.", "WiFiConThread", dhcp);
        dev_system(dhcp);
        if (quiet && !pause_ms(5000)) return;
        if (!request("STATUS", reply)) {
            LOGE("wifi_setip_func::status fails.");
            ctrl_close();
            dev_system("pv_wifi_close.sh");
            return;
        }
        if (!mmi_wifi_parse_status(reply, strlen(reply)).linkLocal) break;
        // A link-local address: the network's DHCP did not answer yet; ask again.
        if (!pause_ms(1000)) return;
        request("RECONNECT", reply);
    }
    if (!mmi_wifi_parse_status(reply, strlen(reply)).completed) {
        LOGE("%s::wpa_state=COMPLETED not found. Fail to connect to router.", "WiFiConThread");
        set_link_state(1);
        tell_main(MSG_CALLBACK, 0);
        dev_system(kCloseScript);
        return;
    }
    char address[MMI_WIFI_TEXT_SIZE] = {};
    const int ret = get_ipaddr(address);
    if (ret == 0 && strstr(address, "169.254.") == nullptr) {
        set_address(address);
        if (!quiet) {
            Generate_QrencodePicture(address, static_cast<int>(strlen(address)), kQrPicture);
            set_link_state(2);
            link_changed();
        } else {
            set_link_state(2);
        }
        return;
    }
    if (ret == 0)
        LOGE("%s: error:Get private ip address. ip: %s", "WiFiConThread", address);
    else
        LOGE("%s: error:Can not get ip address. ret: %d", "WiFiConThread", ret);
    set_link_state(1);
    ctrl_close();
    if (!quiet) link_changed();
    dev_system(kCloseScript);
}

void *connection_thread(void *arg) {
    mmi_thread_stop_install();
    WiFiConThread(arg);
    worker_done(MMI_WIFI_CON_THREAD);
    return nullptr;
}

void *monitor_thread(void *arg) {
    mmi_thread_stop_install();
    wifi_status_monitor_thread(arg);
    worker_done(MMI_WIFI_MONITOR_THREAD);
    return nullptr;
}

// Probes the connection thread and ends a live one; the log says which it was.
bool end_connection_thread_if_alive() {
    const int r = mmi_wifi_probe_thread(MMI_WIFI_CON_THREAD);
    if (r == ESRCH) {
        LOGD("WiFiConThread is not exist.");
        return false;
    }
    if (r != 0) {
        LOGD("Send siganl fail.");
        return false;
    }
    LOGD("WiFiConThread exists. kill it first.");
    return true;
}

// ---- UDP echo ----

std::atomic<int> s_udpSocket{-1};
std::atomic<bool> s_udpStop{false};

void udp_server() {
    const int sock = socket(AF_INET, SOCK_DGRAM, 0);
    if (sock < 0) {
        LOGE("%s: socket() failed", "wificpt_udpserver_thread");
        return;
    }
    struct sockaddr_in addr;
    memset(&addr, 0, sizeof addr);
    if (dev_service_addr("wlan0", MMI_WIFI_UDP_PORT, &addr) != 0 ||
        bind(sock, reinterpret_cast<struct sockaddr *>(&addr), sizeof addr) != 0) {
        LOGE("%s: bind() failed", "wificpt_udpserver_thread");
        close(sock);
        return;
    }
    s_udpSocket = sock;
    LOGD("%s: echo on %s:%d", "wificpt_udpserver_thread", inet_ntoa(addr.sin_addr),
         ntohs(addr.sin_port));
    char buf[MMI_WIFI_UDP_MAX];
    while (!s_udpStop.load() && !mmi_thread_stop_requested()) {
        struct sockaddr_in from;
        socklen_t fromLen = sizeof from;
        const ssize_t n = recvfrom(sock, buf, sizeof buf, 0,
                                   reinterpret_cast<struct sockaddr *>(&from), &fromLen);
        if (s_udpStop.load() || mmi_thread_stop_requested()) break;
        if (n < 0) {
            if (errno == EINTR) continue;
            break;
        }
        LOGD("%s recvfrom len %d", "wificpt_udpserver_thread", static_cast<int>(n));
        const ssize_t ret = sendto(sock, buf, static_cast<size_t>(n), 0,
                                   reinterpret_cast<struct sockaddr *>(&from), fromLen);
        LOGD("%s ret %d", "wificpt_udpserver_thread", static_cast<int>(ret));
    }
    // Ended by itself (not by the disable, which closes the socket): close it here.
    int mine = sock;
    if (s_udpSocket.compare_exchange_strong(mine, -1)) close(sock);
}

void *udp_thread(void *) {
    mmi_thread_stop_install();
    udp_server();
    worker_done(MMI_WIFI_UDP_THREAD);
    return nullptr;
}

// The first line of a shell line's output (at most size - 1 bytes, zero-filled after it),
// and the second one when asked.
void first_lines(const char *cmd, char *first, char *second, size_t size) {
    memset(first, 0, size);
    if (second != nullptr) memset(second, 0, size);
    FILE *fp = dev_popen(cmd, "r");
    if (fp == nullptr) return;
    if (fgets(first, static_cast<int>(size), fp) != nullptr && second != nullptr)
        fgets(second, static_cast<int>(size), fp);
    dev_pclose(fp);
}

}  // namespace

// ---- settings ----

int MMI_WiFi_GetConfigParas(void) {
    char value[FTX_CFG_TEXT_SIZE] = {};
    Read_MainCfgFile("MMI", "WiFiCtrlParameter", value, "");
    ftx_config_para p[kParams];
    memset(p, 0, sizeof p);
    const int n = ftx_config_parse_parameter(value, p, kParams);
    // The reader copies a value over what is there: every field starts empty.
    Settings s;
    memset(&s, 0, sizeof s);
    FILE *fp = dev_fopen(kSsidFile, "r");
    if (fp != nullptr) {
        char line[MMI_WIFI_TEXT_SIZE] = {};
        if (fgets(line, sizeof line, fp) != nullptr) line[strcspn(line, "\r\n")] = '\0';
        fclose(fp);
        tp_os_strlcpy(s.ssid, line, sizeof s.ssid);
    } else {
        LOGD("%s open /cache/pv_wifi_switch_ssid.cfg fail.", __func__);
        ftx_config_get_para_value(p, n, "def_ssid", s.ssid, sizeof s.ssid, "DFX_WIFI_TEST");
    }
    ftx_config_get_para_value(p, n, "key_mgmt", s.keyMgmt, sizeof s.keyMgmt, "WPA-PSK");
    ftx_config_get_para_value(p, n, "psk", s.psk, sizeof s.psk, "kqmtrel459");
    ftx_config_get_para_value(p, n, "def_ip", s.defIp, sizeof s.defIp, "192.168.10.100");
    ftx_config_get_para_value(p, n, "def_gw", s.defGw, sizeof s.defGw, "192.168.10.1");
    char init[FTX_CFG_TEXT_SIZE] = {};
    ftx_config_get_para_value(p, n, "wifi_init", init, sizeof init, "0");
    s.init = atoi(init);
    LOGD("%s ssid=%s key_mgmt=%s wifi_init=%d", __func__, s.ssid, s.keyMgmt, s.init);
    std::lock_guard<std::mutex> lk(s_settingsLock);
    s_settings = s;
    return 0;
}

// ---- the link ----

int WiFiConThreadStart(void) {
    return start_worker(MMI_WIFI_CON_THREAD, connection_thread, nullptr);
}

void *WiFiConThread(void *arg) {
    connection(static_cast<int>(reinterpret_cast<intptr_t>(arg)));
    return nullptr;
}

int get_ipaddr(char *text) {
    text[0] = '\0';
    if (dev_if_ipv4("wlan0", text, MMI_WIFI_TEXT_SIZE) != 0) {
        text[0] = '\0';
        LOGE("ioctl error while getting ip address info on wlan0.");
        return -1;
    }
    return 0;
}

int check_ipaddr(void) {
    char now[MMI_WIFI_TEXT_SIZE] = {};
    if (get_ipaddr(now) != 0) return -1;
    {
        std::lock_guard<std::mutex> lk(s_addressLock);
        if (strcmp(now, s_address) == 0) return -1;
    }
    Generate_QrencodePicture(now, static_cast<int>(strlen(now)), kQrPicture);
    set_address(now);
    return 0;
}

int wifi_close_thread(int mode) {
    tp_os_usleep(2000000);
    char cmd[64], reply[kReplySize];
    const int id = s_netId.load();
    snprintf(cmd, sizeof cmd, "DISABLE_NETWORK %d", id);
    if (!request(cmd, reply)) LOGE("mmi_WiFiConnect::disable_network fails.");
    snprintf(cmd, sizeof cmd, "REMOVE_NETWORK %d", id);
    if (!request(cmd, reply)) LOGE("mmi_WiFiConnect::remove_network fails.");
    if (mode != 1) stop_worker(MMI_WIFI_MONITOR_THREAD);
    ctrl_close();
    dev_system("toybox ifconfig wlan0 down");
    dev_system(kCloseScript);
    set_link_state(1);
    if (mode != 1) bars_refresh();
    return 0;
}

int wifi_status_monitor_thread_start(void) {
    return start_worker(MMI_WIFI_MONITOR_THREAD, monitor_thread, nullptr);
}

void *wifi_status_monitor_thread(void *) {
    char reply[kReplySize];
    size_t replyLen = 0;
    if (!request("STATUS", reply, &replyLen)) {
        LOGE("wifi_setip_func::status fails.");
        ctrl_close();
        return nullptr;
    }
    for (;;) {
        if (mmi_wifi_parse_status(reply, replyLen).completed) {
            const bool changed = check_ipaddr() == 0;
            if (WiFiLinkState.load() != 2) {
                set_link_state(2);
                link_changed();
            } else if (changed) {
                link_changed();
            }
        } else if (WiFiLinkState.load() == 2) {
            set_link_state(1);
            bars_refresh();
        }
        if (!pause_ms(10000)) return nullptr;
        if (!request("STATUS", reply, &replyLen)) {
            if (mmi_thread_stop_requested()) return nullptr;
            LOGE("wifi_setip_func::status fails.");
            ctrl_close();
            return nullptr;
        }
    }
}

int wifi_disconnect(void) {
    wifi_close_thread(0);
    tp_os_usleep(100000);
    for (const char *line : {"iwpriv wlan0 setPower 1", "iwpriv wlan0 setPower 9", "rmmod wlan",
                             "ptt_socket_app -f", "insmod /vendor/lib/modules/wlan.ko con_mode=5"})
        dev_system(line);
    return 0;
}

// ---- the PC's commands ----

int mmi_AutoTest_WiFi_Enable(void) {
    if (end_connection_thread_if_alive()) {
        stop_worker(MMI_WIFI_CON_THREAD);
        dev_system("toybox ifconfig wlan0 down");
        dev_system(kCloseScript);
    }
    WiFiConThreadStart();
    return 1;
}

int mmi_AutoTest_WiFi_Disable(void) {
    // The main menu's link key: it ends a link that is up and starts one that is not.
    tell_main(MSG_KEYDOWN, SCANCODE_F4);
    return 1;
}

int mmi_AutoTest_SwitchSSID(const char *parm, int, char *, unsigned int) {
    const char *ssid = parm != nullptr ? parm : "";
    if (strstr(ssid, "DFX_WIFI_TEST") != nullptr) {
        dev_unlink(kSsidFile);
    } else {
        FILE *fp = dev_fopen(kSsidFile, "w");
        if (fp == nullptr) {
            LOGE("%s open %s fail.", __func__, kSsidFile);
            return 0;
        }
        fputs(ssid, fp);
        fclose(fp);
    }
    if (ctrl_exists()) {
        wifi_close_thread(0);
        tp_os_usleep(2000000);
        if (end_connection_thread_if_alive()) stop_worker(MMI_WIFI_CON_THREAD);
    }
    {
        std::lock_guard<std::mutex> lk(s_settingsLock);
        tp_os_strlcpy(s_settings.ssid, ssid, sizeof s_settings.ssid);
    }
    WiFiConThreadStart();
    return 1;
}

int mmi_AutoTest_GetWiFiRSSI(const char *, int, char *reply, unsigned int size) {
    char line[MMI_WIFI_UDP_MAX + 1], rssi[17];
    first_lines("wpa_cli -i wlan0 -p /data/misc/wifi/sockets signal_poll", line, nullptr,
                sizeof line);
    mmi_wifi_line_field(line, sizeof line, 5, 16, rssi);
    if (reply != nullptr && size > 0) tp_os_strlcpy(reply, rssi, size);
    LOGD("%s rssi=%s", __func__, rssi);
    return 1;
}

int mmi_AutoTest_GetAPInfo(const char *, int, char *reply, unsigned int size) {
    char first[MMI_WIFI_UDP_MAX + 1], second[MMI_WIFI_UDP_MAX + 1];
    first_lines("wpa_cli -i wlan0 -p /data/misc/wifi/sockets status", first, second, sizeof first);
    char bssid[33], freq[17];
    mmi_wifi_line_field(first, sizeof first, 6, 32, bssid);
    mmi_wifi_line_field(second, sizeof second, 5, 16, freq);
    char mac[32] = {};
    unsigned char m[6];
    if (dev_if_hwaddr("wlan0", m) == 0) {
        snprintf(mac, sizeof mac, "%02x:%02x:%02x:%02x:%02x:%02x", m[0], m[1], m[2], m[3], m[4],
                 m[5]);
    } else {
        LOGE("get_wlan0_mac: ioctl SIOCGIFHWADDR error");
        LOGE("get wlan0 mac error");
    }
    char address[MMI_WIFI_TEXT_SIZE];
    mmi_wifi_address(address, sizeof address);
    // At most 128 bytes, whatever room the PC gives.
    char all[sizeof bssid + sizeof freq + sizeof address + sizeof mac + 4];
    snprintf(all, sizeof all, "%s,%s,%s,%s", bssid, freq, address, mac);
    if (reply != nullptr && size > 0) tp_os_strlcpy(reply, all, size < 129 ? size : 129);
    return 1;
}

int mmi_Autotest_WiFiUDPServ_Enable(const char *, int, char *, unsigned int) {
    for (const char *line :
         {"iwpriv wlan0 setPower 2", "iwpriv wlan0 setPower 10", "iwpriv wlan0 setPower 0"})
        dev_system(line);
    s_udpStop = false;
    if (start_worker(MMI_WIFI_UDP_THREAD, udp_thread, nullptr) != 0) {
        LOGE("%s create thread failed", __func__);
        return 0;
    }
    return 1;
}

int mmi_Autotest_WiFiUDPServ_Disable(const char *, int, char *, unsigned int) {
    s_udpStop = true;
    const int sock = s_udpSocket.exchange(-1);
    if (sock >= 0) shutdown(sock, SHUT_RDWR);  // wakes the thread's receive
    stop_worker(MMI_WIFI_UDP_THREAD);
    if (sock >= 0) close(sock);
    dev_system("iwpriv wlan0 setPower 1");
    dev_system("iwpriv wlan0 setPower 9");
    return 1;
}

// ---- what the main window asks ----

int mmi_wifi_link_state(void) {
    return WiFiLinkState.load();
}

int mmi_wifi_init_flag(void) {
    return settings().init;
}

int mmi_wifi_picture_enabled(void) {
    return 1;
}

int mmi_wifi_probe_thread(int which) {
    if (which < 0 || which > 2) return EINVAL;
    std::lock_guard<std::mutex> lk(s_workersLock);
    const Worker &w = s_workers[which];
    return w.alive ? pthread_kill(w.tid, 0) : ESRCH;
}

void mmi_wifi_address(char *out, size_t size) {
    std::lock_guard<std::mutex> lk(s_addressLock);
    tp_os_strlcpy(out, s_address, size);
}
