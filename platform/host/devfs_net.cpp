// The handset's network interfaces on the host. "wlan0" is the simulated Wi-Fi network
// (sim/wifi): its address is the one the simulated DHCP handed out while the supplicant holds
// a completed link, its hardware address the one sim/device.ini gives. Other names are the
// host interfaces dev_ifname maps them to.
#include <arpa/inet.h>
#include <ifaddrs.h>
#include <net/if.h>
#include <netinet/in.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <unistd.h>

#include <string>

#include "devfs.h"
#include "ftx_host.h"
#include "wifi_link.h"

namespace {

const char kWlan[] = "wlan0";
// A locally administered address, unless sim/device.ini [wifi] mac= names another.
const char kDefaultWlanMac[] = "02:00:00:00:00:01";

// The first IPv4 address of a host interface.
int host_ipv4(const char *hostName, struct in_addr *out) {
    struct ifaddrs *list = nullptr;
    if (getifaddrs(&list) != 0) return -1;
    int rc = -1;
    for (struct ifaddrs *i = list; i != nullptr; i = i->ifa_next) {
        if (i->ifa_addr == nullptr || i->ifa_addr->sa_family != AF_INET) continue;
        if (strcmp(i->ifa_name, hostName) != 0) continue;
        *out = reinterpret_cast<struct sockaddr_in *>(i->ifa_addr)->sin_addr;
        rc = 0;
        break;
    }
    freeifaddrs(list);
    return rc;
}

int parse_mac(const char *text, unsigned char mac[6]) {
    unsigned int b[6];
    char tail;
    if (sscanf(text, "%2x:%2x:%2x:%2x:%2x:%2x%c", &b[0], &b[1], &b[2], &b[3], &b[4], &b[5],
               &tail) != 6)
        return -1;
    for (int i = 0; i < 6; i++)
        mac[i] = static_cast<unsigned char>(b[i]);
    return 0;
}

int copy_out(const std::string &text, char *out, size_t size) {
    if (text.empty() || text.size() + 1 > size) return -1;
    memcpy(out, text.c_str(), text.size() + 1);
    return 0;
}

}  // namespace

extern "C" int dev_if_ipv4(const char *name, char *out, size_t size) {
    if (name == nullptr || out == nullptr || size == 0) return -1;
    out[0] = '\0';
    if (strcmp(name, kWlan) == 0) {
        const std::string root = dev_root();
        if (!ftxhost::wifi_supplicant_running(root)) return -1;
        auto link = ftxhost::wifi_read_link(root);
        if (link["wpa_state"] != "COMPLETED") return -1;
        return copy_out(link["ip"], out, size);
    }
    struct in_addr addr;
    char text[INET_ADDRSTRLEN];
    if (host_ipv4(dev_ifname(name), &addr) != 0 ||
        inet_ntop(AF_INET, &addr, text, sizeof(text)) == nullptr)
        return -1;
    return copy_out(text, out, size);
}

extern "C" int dev_if_hwaddr(const char *name, unsigned char mac[6]) {
    if (name == nullptr || mac == nullptr) return -1;
    if (strcmp(name, kWlan) == 0) {
        char text[64];
        ftx_device_ini_get("wifi", "mac", text, sizeof(text), kDefaultWlanMac);
        return parse_mac(text, mac);
    }
    int fd = socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    struct ifreq req;
    memset(&req, 0, sizeof(req));
    snprintf(req.ifr_name, sizeof(req.ifr_name), "%s", dev_ifname(name));
    int rc = ioctl(fd, SIOCGIFHWADDR, &req);
    close(fd);
    if (rc != 0) return -1;
    memcpy(mac, req.ifr_hwaddr.sa_data, 6);
    return 0;
}

extern "C" int dev_service_addr(const char *name, int port, void *sockaddr_in_out) {
    if (name == nullptr || sockaddr_in_out == nullptr || port < 0 || port > 65535) return -1;
    struct in_addr addr;
    if (host_ipv4(dev_ifname(name), &addr) != 0) return -1;
    const std::string key = "udp_" + std::to_string(port);
    int hostPort = ftx_device_ini_get_int("ports", key.c_str(), port);
    if (hostPort <= 0 || hostPort > 65535) hostPort = port;
    struct sockaddr_in sin;
    memset(&sin, 0, sizeof(sin));
    sin.sin_family = AF_INET;
    sin.sin_port = htons(static_cast<uint16_t>(hostPort));
    sin.sin_addr = addr;
    memcpy(sockaddr_in_out, &sin, sizeof(sin));
    return 0;
}
