// dev_popen and the network interface calls on the host.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/wait.h>

#include <string>

#include <gtest/gtest.h>

#include "devfs.h"
#include "ftx_host.h"
#include "support/temp_root.h"

namespace {

std::string read_all(FILE *fp) {
    std::string out;
    char buf[256];
    size_t n;
    while ((n = fread(buf, 1, sizeof(buf), fp)) > 0)
        out.append(buf, n);
    return out;
}

TEST(DevPopen, StreamsALinesOutputOrInputUnderTheShellLineRules) {
    TempRoot root;
    root.write("/data/a.txt", "one\ntwo\n");
    FILE *fp = dev_popen("toybox cat /data/a.txt; exit 3", "r");
    ASSERT_NE(nullptr, fp);
    EXPECT_EQ("one\ntwo\n", read_all(fp));
    int status = dev_pclose(fp);
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(3, WEXITSTATUS(status));

    fp = dev_popen("cat > /data/b.txt", "w");
    ASSERT_NE(nullptr, fp);
    fputs("written through the pipe", fp);
    EXPECT_EQ(0, dev_pclose(fp));
    EXPECT_EQ("written through the pipe", root.read("/data/b.txt"));

    EXPECT_EQ(nullptr, dev_popen("/data/x.sh", "r"));
    EXPECT_EQ(nullptr, dev_popen("echo x", "a"));
    EXPECT_EQ(-1, dev_pclose(stdin)) << "not a stream of dev_popen";
    const std::string shell = root.read("/log/shell.txt");
    EXPECT_NE(std::string::npos, shell.find(" toybox cat /data/a.txt; exit 3\n"));
    EXPECT_NE(std::string::npos, shell.find("refused: /data/x.sh"));
}

TEST(DevIf, OtherInterfacesAreTheMappedHostOnesAndWlanIsTheModels) {
    TempRoot root;
    char ip[32];
    EXPECT_EQ(0, dev_if_ipv4("lo", ip, sizeof(ip)));
    EXPECT_STREQ("127.0.0.1", ip);
    EXPECT_EQ(-1, dev_if_ipv4("lo", ip, 4));
    EXPECT_EQ(-1, dev_if_ipv4("wlan0", ip, sizeof(ip))) << "no supplicant, no address";
    EXPECT_EQ(-1, dev_if_ipv4("nosuch9", ip, sizeof(ip)));

    unsigned char mac[6];
    ASSERT_EQ(0, dev_if_hwaddr("wlan0", mac));
    EXPECT_EQ(0x02, mac[0]);
    EXPECT_EQ(0x01, mac[5]);
    root.write("/sim/device.ini", "[wifi]\nmac=0a:1b:2c:3d:4e:5f\n");
    ftx_host_reset();
    ASSERT_EQ(0, dev_if_hwaddr("wlan0", mac));
    EXPECT_EQ(0x0a, mac[0]);
    EXPECT_EQ(0x5f, mac[5]);
    EXPECT_EQ(-1, dev_if_hwaddr("nosuch9", mac));
}

TEST(DevServiceAddr, TheMappedInterfacesAddressAndTheMovedPort) {
    TempRoot root;
    struct sockaddr_in sin;
    ASSERT_EQ(0, dev_service_addr("wlan0", 3536, &sin));
    EXPECT_EQ(AF_INET, sin.sin_family);
    EXPECT_EQ(3536, ntohs(sin.sin_port));
    EXPECT_EQ(htonl(INADDR_LOOPBACK), sin.sin_addr.s_addr);
    root.write("/sim/device.ini",
               "[ports]\nudp_3536=40001\nudp_7=junk\n[network]\nwlan0=nosuch9\n");
    ftx_host_reset();
    EXPECT_EQ(-1, dev_service_addr("wlan0", 3536, &sin)) << "the mapped interface is missing";
    ASSERT_EQ(0, dev_service_addr("lo", 3536, &sin));
    EXPECT_EQ(40001, ntohs(sin.sin_port));
    ASSERT_EQ(0, dev_service_addr("lo", 7, &sin));
    EXPECT_EQ(7, ntohs(sin.sin_port));
    EXPECT_EQ(-1, dev_service_addr("lo", 70000, &sin));
}

}  // namespace
