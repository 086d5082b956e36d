// The "FileOptMoudle" operations: formats, and that no parameter reaches outside the root.
#include <sys/mount.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include "devfs.h"
#include "fileopt.h"
#include "support/temp_root.h"

namespace {

using ftxsim::fileopt_read;
using ftxsim::fileopt_remove;
using ftxsim::fileopt_write;

std::string read(const std::string &parm, int *ok = nullptr) {
    char reply[256];
    size_t len = 0;
    int r = fileopt_read(parm, reply, sizeof(reply), &len);
    if (ok != nullptr) *ok = r;
    return std::string(reply, len);
}

std::string write(const std::string &parm, int *ok = nullptr) {
    char reply[256];
    int r = fileopt_write(parm, reply, sizeof(reply));
    if (ok != nullptr) *ok = r;
    return reply;
}

std::string remove(const std::string &parm, int *ok = nullptr) {
    char reply[256];
    int r = fileopt_remove(parm, reply, sizeof(reply));
    if (ok != nullptr) *ok = r;
    return reply;
}

class FileOpt : public ::testing::Test {
  protected:
    TempRoot root_;
};

TEST_F(FileOpt, WriteReadRemoveRoundTrip) {
    int ok;
    EXPECT_EQ(write("/data/pc/x.txt,line1\\nline2", &ok), "*11");
    EXPECT_EQ(ok, 1);
    EXPECT_EQ(root_.read("/data/pc/x.txt"), "line1\nline2") << "folders are made";
    EXPECT_EQ(write("+/data/pc/x.txt,\\x00\\xff,z"), "*4");
    EXPECT_EQ(read("/data/pc/x.txt"), std::string("*line1\nline2\0\xff,z", 16));
    EXPECT_EQ(read("/data/pc/x.txt,6"), "*line2" + std::string("\0\xff,z", 4));
    EXPECT_EQ(read("/data/pc/x.txt,0,5"), "*line1");
    EXPECT_EQ(read("/data/pc/x.txt,99"), "*");
    EXPECT_EQ(remove("/data/pc/x.txt", &ok), "*removed");
    EXPECT_EQ(ok, 1);
    EXPECT_FALSE(root_.exists("/data/pc/x.txt"));
    EXPECT_EQ(remove("/data/pc", &ok), "*removed") << "an empty folder may go";
}

TEST_F(FileOpt, LongFilesAreCutToTheReply) {
    root_.write("/etc/big", std::string(1000, 'b'));
    std::string r = read("/etc/big");
    EXPECT_EQ(r.size(), 255u) << "'*' and 254 bytes fit a 256-byte reply with its NUL";
}

TEST_F(FileOpt, BadInputIsAnsweredClearly) {
    int ok;
    EXPECT_EQ(read("/etc/none", &ok).rfind("ERROR ", 0), 0u);
    EXPECT_EQ(ok, 0);
    EXPECT_EQ(read("/etc/none,x"), "ERROR expected PATH[,OFFSET[,LENGTH]]");
    EXPECT_EQ(read("/etc/none,1,-2"), "ERROR expected PATH[,OFFSET[,LENGTH]]");
    EXPECT_EQ(write("/etc/nodata"), "ERROR expected PATH,DATA");
    EXPECT_EQ(write("/etc/f,bad\\q"), "ERROR bad escape in data");
    EXPECT_EQ(write("/etc/f,bad\\x4"), "ERROR bad escape in data");
    EXPECT_EQ(remove("/etc/none", &ok).rfind("ERROR ", 0), 0u);
    root_.write("/etc/full/a", "1");
    EXPECT_EQ(remove("/etc/full", &ok).rfind("ERROR ", 0), 0u) << "a folder with files stays";
    EXPECT_EQ(read("/"), "ERROR not a file path");
    // A FIFO would block the channel's only thread.
    std::filesystem::create_directories(root_.host("/run"));
    ASSERT_EQ(mkfifo(root_.host("/run/fifo").c_str(), 0600), 0);
    EXPECT_EQ(read("/run/fifo"), "ERROR not a regular file");
    EXPECT_EQ(write("/run/fifo,x"), "ERROR not a regular file");
    EXPECT_EQ(read("/run"), "ERROR not a regular file");
    EXPECT_EQ(read(""), "ERROR path must be an absolute device path");
}

TEST_F(FileOpt, NothingEscapesTheRoot) {
    std::string outside = root_.path() + "-outside";
    std::filesystem::create_directories(outside);
    {
        FILE *f = fopen((outside + "/secret").c_str(), "w");
        fputs("secret", f);
        fclose(f);
    }
    root_.write("/data/in.txt", "inside");
    std::filesystem::create_directories(root_.host("/data/links"));
    symlink((outside + "/secret").c_str(), root_.host("/data/links/out").c_str());
    symlink(outside.c_str(), root_.host("/data/links/outdir").c_str());
    symlink("../in.txt", root_.host("/data/links/in").c_str());

    for (const char *bad : {"etc/passwd", "../x", "/data/../../x", "/data/..", "/data/x/..",
                            "/data/links/out", "/data/links/outdir/secret"}) {
        EXPECT_EQ(read(bad).rfind("ERROR", 0), 0u) << bad;
        EXPECT_EQ(write(std::string(bad) + ",pwned").rfind("ERROR", 0), 0u) << bad;
    }
    // No folder is made before the place it lands in was checked.
    EXPECT_EQ(write("/data/links/outdir/new/sub/f,x"), "ERROR path leaves the device root");
    EXPECT_FALSE(std::filesystem::exists(outside + "/new"));
    EXPECT_EQ(read("/data/links/in"), "*inside") << "a link that stays inside is followed";
    EXPECT_EQ(write("/data/links/in,changed"), "ERROR will not write through a symbolic link");
    EXPECT_EQ(remove("/data/links/outdir/secret").rfind("ERROR", 0), 0u);
    EXPECT_EQ(write("/data/ctl\x01name,x"), "ERROR control character in path");
    // A host path is only a device path: it lands inside the root.
    EXPECT_EQ(write(outside + "/secret,pwned"), "*5");
    FILE *f = fopen((outside + "/secret").c_str(), "r");
    char buf[16] = "";
    fgets(buf, sizeof(buf), f);
    fclose(f);
    EXPECT_STREQ(buf, "secret");
    EXPECT_EQ(root_.read(outside + "/secret"), "pwned");
    std::filesystem::remove_all(outside);
}

TEST_F(FileOpt, TheSystemPartitionIsReadOnlyUntilRemounted) {
    root_.write("/system/bin/iwpriv", "data");
    std::filesystem::create_directories(root_.host("/data"));
    symlink(root_.host("/system/bin").c_str(), root_.host("/data/sysbin").c_str());
    for (const char *p : {"/system/bin/iwpriv", "/system/bin/new/tool", "/data/sysbin/iwpriv",
                          "/system/x", "+/system/bin/iwpriv"}) {
        EXPECT_EQ(write(std::string(p) + ",#!/bin/sh"), "ERROR read-only file system") << p;
    }
    EXPECT_EQ(remove("/system/bin/iwpriv"), "ERROR read-only file system");
    EXPECT_EQ(remove("/system"), "ERROR read-only file system");
    EXPECT_EQ(root_.read("/system/bin/iwpriv"), "data");
    EXPECT_FALSE(root_.exists("/system/bin/new"));
    EXPECT_EQ(read("/system/bin/iwpriv"), "*data") << "reading stays allowed";
    EXPECT_EQ(remove("/data/sysbin"), "*removed") << "the link goes, not what it points to";

    dev_mount("/dev/block/bootdevice/by-name/system", "/system", "ext4", MS_REMOUNT, nullptr);
    EXPECT_EQ(write("/system/bin/iwpriv,changed"), "*7");
    EXPECT_EQ(write("/system/bin/new/tool,x"), "*1");
    EXPECT_EQ(remove("/system/bin/new/tool"), "*removed");
}

}  // namespace
