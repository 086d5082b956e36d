/* Device file system and device services. On a handset these are plain
 * pass-throughs; on the host every absolute device path is taken inside the
 * device root ($FTX_ROOT) and nothing reaches the real machine. */
#ifndef FTX_DEVFS_H
#define FTX_DEVFS_H

#include <dirent.h>
#include <stddef.h>
#include <stdio.h>
#include <sys/stat.h>
#include <sys/types.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Linux reboot commands, as the handset's reboot() takes them. */
#define LINUX_REBOOT_CMD_RESTART 0x01234567
#define LINUX_REBOOT_CMD_POWER_OFF 0x4321FEDC

/* Host exit statuses of dev_reboot; the launcher restarts on a reboot. */
#define DEV_EXIT_POWER_OFF 100
#define DEV_EXIT_REBOOT 101

/* The device root folder (no trailing slash). */
const char *dev_root(void);

/* Maps a device path into the device root: "." and ".." are resolved (never above the
 * root), a relative path is taken from the handset's working directory "/", and the root
 * is put in front. Returns 0, or -1 when out is too small. */
int dev_path(const char *path, char *out, size_t size);

FILE *dev_fopen(const char *path, const char *mode);
int dev_open(const char *path, int flags, ...);
int dev_access(const char *path, int mode);
int dev_stat(const char *path, struct stat *st);
int dev_mkdir(const char *path, mode_t mode);
int dev_unlink(const char *path);
int dev_rename(const char *from, const char *to);
DIR *dev_opendir(const char *path);

/* Runs a device shell line and returns its wait status as system() does. The handset's
 * tools it names are the build's own programs (never files of the device root), its paths
 * are taken inside the root, and a line that would run anything else is refused with
 * exit status 127 and an error in the log. */
int dev_system(const char *cmd);

/* Powers off or reboots (cmd is a LINUX_REBOOT_CMD_...). Never returns on the host. */
int dev_reboot(int cmd);
void dev_sync(void);
int dev_mount(const char *source, const char *target, const char *fstype, unsigned long flags,
              const void *data);

/* The host name of a handset network interface ("wlan0" -> "lo" by default). */
const char *dev_ifname(const char *name);

/* Runs a device shell line (checked and rewritten as dev_system does) with its standard
 * output (mode "r") or input ("w") on the returned stream; dev_pclose gives the wait status.
 * NULL when the line is refused or cannot run. */
FILE *dev_popen(const char *cmd, const char *mode);
int dev_pclose(FILE *fp);

/* The IPv4 address of a handset network interface as dotted text (the SIOCGIFADDR answer):
 * 0, or -1 when the interface has none. On the host, "wlan0" answers the simulated Wi-Fi
 * network's address once its DHCP step handed one out, until the link or the interface
 * goes down. */
int dev_if_ipv4(const char *name, char *out, size_t size);
/* The hardware address of a handset network interface (the SIOCGIFHWADDR answer): 0, or -1. */
int dev_if_hwaddr(const char *name, unsigned char mac[6]);

/* The host address a handset service binds for interface name (sockaddr_in, network order)
 * and the host port for its device port: on a handset the interface's own address and the
 * same port; on the host the mapped interface's address and the port sim/device.ini moves
 * it to ([ports] udp_3536=N), so that several handsets can run side by side. 0, or -1. */
int dev_service_addr(const char *name, int port, void *sockaddr_in_out);

#ifdef __cplusplus
}
#endif
#endif
