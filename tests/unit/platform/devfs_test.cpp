#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include "devfs.h"
#include "support/temp_root.h"

std::string ftx_map_shell_line(const char *cmd);

namespace {

std::string mapped(const char *p) {
    char buf[512];
    EXPECT_EQ(0, dev_path(p, buf, sizeof(buf)));
    return buf;
}

TEST(DevPath, AbsolutePathsStayInsideTheRoot) {
    TempRoot root;
    EXPECT_EQ(root.path() + "/etc/ftx_config.ini", mapped("/etc/ftx_config.ini"));
    EXPECT_EQ(root.path() + "/cache/ftx/", mapped("/cache/ftx/"));
    EXPECT_EQ(root.path() + "/etc/passwd", mapped("/data/../../../etc/passwd"));
    EXPECT_EQ(root.path() + "/a/c", mapped("//a/./b/../c"));
    EXPECT_EQ(root.path(), mapped("/.."));
    EXPECT_EQ("relative/x", mapped("relative/x"));

    char tiny[8];
    EXPECT_EQ(-1, dev_path("/etc/ftx_config.ini", tiny, sizeof(tiny)));
    EXPECT_STREQ("", tiny);
}

TEST(DevPath, FileCallsWorkOnTheRoot) {
    TempRoot root;
    ASSERT_EQ(0, dev_mkdir("/data", 0755));
    FILE *f = dev_fopen("/data/x.txt", "w");
    ASSERT_NE(nullptr, f);
    fputs("hello", f);
    fclose(f);
    EXPECT_EQ("hello", root.read("/data/x.txt"));
    EXPECT_EQ(0, dev_access("/data/x.txt", R_OK));
    struct stat st;
    EXPECT_EQ(0, dev_stat("/data/x.txt", &st));
    EXPECT_EQ(5, st.st_size);
    int fd = dev_open("/data/y.txt", O_CREAT | O_WRONLY, 0600);
    ASSERT_GE(fd, 0);
    close(fd);
    EXPECT_EQ(0, dev_rename("/data/y.txt", "/data/z.txt"));
    EXPECT_TRUE(root.exists("/data/z.txt"));
    DIR *d = dev_opendir("/data");
    ASSERT_NE(nullptr, d);
    closedir(d);
    EXPECT_EQ(0, dev_unlink("/data/x.txt"));
    EXPECT_NE(0, dev_access("/data/x.txt", F_OK));
}

TEST(DevSystem, DevicePathsAreMovedIntoTheRoot) {
    TempRoot root;
    const std::string r = root.path();
    EXPECT_EQ("echo 1 > " + r + "/sys/class/leds/x",
              ftx_map_shell_line("echo 1 > /sys/class/leds/x"));
    EXPECT_EQ("toybox chmod 777 " + r + "/data/a;ls '" + r + "/b'",
              ftx_map_shell_line("toybox chmod 777 /data/a;ls '/b'"));
    EXPECT_EQ("cmd 2>/dev/null", ftx_map_shell_line("cmd 2>/dev/null"));
    EXPECT_EQ("wget http://h/x a/b", ftx_map_shell_line("wget http://h/x a/b"));
    // A path already inside the root is left as it is.
    std::string inside = "cat " + r + "/etc/x";
    EXPECT_EQ(inside, ftx_map_shell_line(inside.c_str()));
}

TEST(DevSystem, RunsTheRootsToolsFirstAndRecordsEveryLine) {
    TempRoot root;
    root.write("/system/bin/toybox",
               "#!/bin/sh\necho \"toybox $*\" > \"$FTX_ROOT/data/toybox.out\"\n");
    chmod(root.host("/system/bin/toybox").c_str(), 0755);
    std::filesystem::create_directories(root.host("/data"));
    int status = dev_system("toybox touch /data/flag");
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(0, WEXITSTATUS(status));
    EXPECT_EQ("toybox touch " + root.path() + "/data/flag\n", root.read("/data/toybox.out"));

    EXPECT_EQ(3, WEXITSTATUS(dev_system("exit 3")));
    std::string shell = root.read("/log/shell.txt");
    EXPECT_NE(std::string::npos, shell.find(" toybox touch /data/flag\n"));
    EXPECT_NE(std::string::npos, shell.find(" exit 3\n"));
}

int g_rebootStatus = 0;
void record_reboot(int status) {
    g_rebootStatus = status;
}

TEST(DevReboot, PowerOffAndRebootBecomeExitStatuses) {
    TempRoot root;
    ftx_set_reboot_hook(record_reboot);
    dev_reboot(LINUX_REBOOT_CMD_POWER_OFF);
    EXPECT_EQ(DEV_EXIT_POWER_OFF, g_rebootStatus);
    dev_reboot(LINUX_REBOOT_CMD_RESTART);
    EXPECT_EQ(DEV_EXIT_REBOOT, g_rebootStatus);
    ftx_set_reboot_hook(nullptr);

    // Without a hook the process really ends with the status.
    pid_t pid = fork();
    if (pid == 0) dev_reboot(LINUX_REBOOT_CMD_POWER_OFF);
    int status = 0;
    waitpid(pid, &status, 0);
    EXPECT_TRUE(WIFEXITED(status));
    EXPECT_EQ(DEV_EXIT_POWER_OFF, WEXITSTATUS(status));
}

TEST(DevIfname, MappedThroughTheDeviceSettings) {
    TempRoot root;
    EXPECT_STREQ("lo", dev_ifname("wlan0"));
    EXPECT_STREQ("eth9", dev_ifname("eth9"));
    root.write("/sim/device.ini", "[network]\r\nwlan0 = veth1\r\n");
    ftx_host_reset();
    EXPECT_STREQ("veth1", dev_ifname("wlan0"));
}

}  // namespace
