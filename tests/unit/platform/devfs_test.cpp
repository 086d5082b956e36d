#include <fcntl.h>
#include <sys/mount.h>
#include <sys/wait.h>
#include <unistd.h>

#include <vector>

#include <gtest/gtest.h>

#include "devfs.h"
#include "ftx_host.h"
#include "support/temp_root.h"

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
    // A relative path is taken from the handset's working directory, "/".
    EXPECT_EQ(root.path() + "/relative/x", mapped("relative/x"));
    EXPECT_EQ(root.path() + "/escaped/", mapped("../escaped/"));

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

std::string prepared(const std::string &line) {
    char out[1024];
    int rc = ftx_shell_prepare(line.c_str(), out, sizeof(out));
    return (rc == 0 ? "" : "refused: ") + std::string(out);
}

const std::string kTools = FTX_TEST_BUILD_DIR "/handset/bin";

TEST(DevSystem, PathsAreTakenInsideTheRootAndToolsFromTheBuild) {
    TempRoot root;
    const std::string r = root.path();
    EXPECT_EQ("'echo' '1' >'" + r + "/sys/class/leds/x'", prepared("echo 1 > /sys/class/leds/x"));
    EXPECT_EQ("'" + kTools + "/toybox' 'chmod' '777' '" + r + "/data/a' ; '" + kTools + "/ls' '" +
                  r + "/b c'",
              prepared("toybox chmod 777 /data/a;ls '/b c'"));
    EXPECT_EQ("'" + kTools + "/rm' '" + r + "/etc/passwd'",
              prepared("rm /data/../../../etc/passwd"));
    EXPECT_EQ("'" + kTools + "/insmod' '" + r + "/vendor/lib/modules/wlan.ko' 'con_mode=5'",
              prepared("insmod /vendor/lib/modules/wlan.ko con_mode=5"));
    EXPECT_EQ("'" + kTools + "/cat' 'if=" + r + "/x' 2>/dev/null 2>&1 >>'" + r + "/log/y'",
              prepared("cat if=/x 2>/dev/null 2>&1 >> log/y"));
    EXPECT_EQ("'echo' '-n' 'FIRST' >'" + r + "/data/pv_autotest_latest_pass'",
              prepared("echo -n FIRST > /data/pv_autotest_latest_pass"));
    EXPECT_EQ("'echo' 'it'\\''s' && 'true' || 'exit' '3' &",
              prepared("echo \"it's\" && true || exit 3 &"));

    // A tool named by its handset path runs the build's tool, and only when the handset has
    // that file.
    EXPECT_EQ("refused: /system/bin/iwpriv: not found", prepared("/system/bin/iwpriv wlan0"));
    root.write("/system/bin/iwpriv", "data only");
    EXPECT_EQ("'" + kTools + "/iwpriv' 'wlan0'", prepared("/system/bin/iwpriv wlan0"));
    EXPECT_EQ("'" + kTools + "/iwpriv'", prepared("/system/bin/../bin/./iwpriv"));
}

TEST(DevSystem, LinesThatWouldRunAnythingElseAreRefused) {
    TempRoot root;
    root.write("/system/bin/evil", "#!/bin/sh\n");
    root.write("/data/x.sh", "#!/bin/sh\n");
    for (const char *line : {"/system/bin/evil",
                             "/data/x.sh",
                             "/usr/bin/id",
                             "evil",
                             "sh -c id",
                             "bash",
                             ". /data/x.sh",
                             "source /data/x.sh",
                             "eval id",
                             "exec /data/x.sh",
                             "command -p id",
                             "env id",
                             "PATH=/system/bin evil",
                             "echo $(id)",
                             "echo `id`",
                             "echo \"$HOME\"",
                             "echo $HOME",
                             "cat /data/*",
                             "cat <<EOF",
                             "echo > ",
                             "echo 'open",
                             "echo \\",
                             "toybox; ../x",
                             "true >&/data/x",
                             "if true; then id; fi",
                             "{ id; }",
                             "x=1",
                             "./x.sh",
                             "iwpriv | sh"}) {
        EXPECT_EQ(0u, prepared(line).rfind("refused: ", 0)) << line << " -> " << prepared(line);
    }
    // Refused lines run nothing and say why.
    int status = dev_system("/data/x.sh");
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(127, WEXITSTATUS(status));
    EXPECT_NE(std::string::npos,
              root.read("/log/shell.txt")
                  .find("refused: /data/x.sh: not a folder of the handset's tools"));
}

TEST(DevSystem, RunsTheBuildsToolsNeverTheRootsAndRecordsEveryLine) {
    TempRoot root;
    // A script planted where the handset keeps its toybox.
    root.write("/system/bin/toybox", "#!/bin/sh\ntouch \"$FTX_ROOT/data/planted\"\n");
    chmod(root.host("/system/bin/toybox").c_str(), 0755);
    std::filesystem::create_directories(root.host("/data"));
    for (const char *line :
         {"toybox touch /data/flag", "/system/bin/toybox touch /data/flag2", "touch data/flag3"}) {
        int status = dev_system(line);
        ASSERT_TRUE(WIFEXITED(status)) << line;
        EXPECT_EQ(0, WEXITSTATUS(status)) << line;
    }
    EXPECT_TRUE(root.exists("/data/flag"));
    EXPECT_TRUE(root.exists("/data/flag2"));
    EXPECT_TRUE(root.exists("/data/flag3")) << "the shell starts in the root";
    EXPECT_FALSE(root.exists("/data/planted"));
    std::string tools = root.read("/log/tools.txt");
    EXPECT_NE(std::string::npos, tools.find("toybox touch /data/flag\n")) << tools;

    EXPECT_EQ(3, WEXITSTATUS(dev_system("exit 3")));
    std::string shell = root.read("/log/shell.txt");
    EXPECT_NE(std::string::npos, shell.find(" toybox touch /data/flag\n"));
    EXPECT_NE(std::string::npos, shell.find(" exit 3\n"));
}

TEST(DevSystem, FileAppletsStayInsideTheRoot) {
    TempRoot root;
    std::string outside = root.path() + "-outside";
    std::filesystem::create_directories(outside);
    root.write("/data/keep", "x");
    std::filesystem::create_directories(root.host("/data/links"));
    symlink(outside.c_str(), root.host("/data/links/out").c_str());
    for (const std::string &line :
         std::vector<std::string>{"rm -rf ../" + std::filesystem::path(outside).filename().string(),
                                  "toybox touch ../escaped", "touch data/links/out/x",
                                  "toybox cp data/keep data/links/out/copy",
                                  "rm --no-preserve-root=/ data", "toybox ls .."}) {
        int status = dev_system(line.c_str());
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) != 0) << line;
    }
    EXPECT_TRUE(std::filesystem::exists(outside));
    EXPECT_TRUE(std::filesystem::is_empty(outside));
    EXPECT_FALSE(std::filesystem::exists(root.path() + "/../escaped"));
    EXPECT_TRUE(root.exists("/data/keep"));
    // Machine-changing applets are only recorded.
    EXPECT_EQ(0, WEXITSTATUS(dev_system("toybox ifconfig lo up")));
    EXPECT_NE(std::string::npos, root.read("/log/tools.txt").find("toybox ifconfig lo up\n"));
    std::filesystem::remove_all(outside);
}

TEST(DevMount, TheSystemPartitionIsWritableOnlyAfterARemount) {
    TempRoot root;
    EXPECT_EQ(0, ftx_host_system_writable());
    dev_mount("/dev/block/bootdevice/by-name/system", "/system/", "ext4", MS_REMOUNT, nullptr);
    EXPECT_EQ(1, ftx_host_system_writable());
    dev_mount("/dev/block/bootdevice/by-name/system", "/system", "ext4", MS_REMOUNT | MS_RDONLY,
              nullptr);
    EXPECT_EQ(0, ftx_host_system_writable());
    dev_mount("/dev/block/bootdevice/by-name/data", "/data", "ext4", MS_REMOUNT, nullptr);
    EXPECT_EQ(0, ftx_host_system_writable());
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
