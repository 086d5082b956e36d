// PC command round trip through the channel, the parser and a read-only handler, against
// a bare TCP echo on loopback measured in the same run; and commands per second on one
// connection.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sched.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <string>
#include <thread>
#include <vector>

#include "adbd_connection/AtThread.h"
#include "core/ftx_lib_binding.h"

namespace {

using Clock = std::chrono::steady_clock;

const char kCommand[] = "testinfoMoudle testItem 5,read\n";

int connect_to(int port) {
    int fd = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_port = htons(static_cast<uint16_t>(port));
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    if (connect(fd, reinterpret_cast<sockaddr *>(&a), sizeof(a)) != 0) {
        close(fd);
        return -1;
    }
    int one = 1;
    setsockopt(fd, IPPROTO_TCP, TCP_NODELAY, &one, sizeof(one));
    return fd;
}

// Reads until `done` says the bytes so far hold a whole answer; returns false on EOF.
template <typename Done>
bool read_answer(int fd, std::string &buf, Done done) {
    char chunk[4096];
    while (!done(buf)) {
        ssize_t n = read(fd, chunk, sizeof(chunk));
        if (n <= 0) return false;
        buf.append(chunk, static_cast<size_t>(n));
    }
    return true;
}

// Length of the first whole channel answer ("<r> <n>\n" + n bytes + "\n") in buf, or 0.
size_t channel_answer_size(const std::string &buf) {
    size_t nl = buf.find('\n');
    if (nl == std::string::npos) return 0;
    size_t sp = buf.find(' ');
    if (sp == std::string::npos || sp > nl) return 0;
    size_t n = strtoul(buf.c_str() + sp + 1, nullptr, 10);
    size_t total = nl + 1 + n + 1;
    return buf.size() >= total ? total : 0;
}

size_t echo_answer_size(const std::string &buf) {
    size_t nl = buf.find('\n');
    return nl == std::string::npos ? 0 : nl + 1;
}

// One command and its answer, timed; the answer is consumed from buf.
template <typename Size>
double round_trip_us(int fd, std::string &buf, Size size) {
    auto t0 = Clock::now();
    if (write(fd, kCommand, sizeof(kCommand) - 1) < 0) return -1;
    if (!read_answer(fd, buf, [&](const std::string &b) { return size(b) != 0; })) return -1;
    std::chrono::duration<double, std::micro> d = Clock::now() - t0;
    buf.erase(0, size(buf));
    return d.count();
}

// A bare echo server on loopback: whatever arrives goes straight back.
int start_echo(std::thread &server) {
    int ls = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t len = sizeof(a);
    if (bind(ls, reinterpret_cast<sockaddr *>(&a), sizeof(a)) != 0 || listen(ls, 1) != 0) return -1;
    getsockname(ls, reinterpret_cast<sockaddr *>(&a), &len);
    server = std::thread([ls] {
        int fd = accept(ls, nullptr, nullptr);
        int one = 1;
        setsockopt(fd, IPPROTO_TCP, TCP_NODELAY, &one, sizeof(one));
        char chunk[4096];
        ssize_t n;
        while ((n = read(fd, chunk, sizeof(chunk))) > 0) {
            if (write(fd, chunk, static_cast<size_t>(n)) < 0) break;
        }
        close(fd);
        close(ls);
    });
    return ntohs(a.sin_port);
}

double median(std::vector<double> v) {
    std::sort(v.begin(), v.end());
    return v[v.size() / 2];
}

}  // namespace

int main() {
    char root[] = "/tmp/ftx-bench-XXXXXX";
    if (mkdtemp(root) == nullptr) return 1;
    setenv("FTX_ROOT", root, 1);
    setenv("FTX_PC_PORT", "0", 1);
    // The parser logs every table row it looks at; at the default floor each command writes
    // some 190 debug lines to logcat, which is the log's cost, not the channel's.
    setenv("FTX_LOG_LEVEL", "I", 0);
    // Client, channel and echo threads share one core (threads inherit it), so neither
    // figure depends on cross-core wake-ups while other work keeps the machine busy.
    cpu_set_t one;
    CPU_ZERO(&one);
    CPU_SET(sched_getcpu(), &one);
    sched_setaffinity(0, sizeof(one), &one);
    if (ftx_init_lib_factory_dll() != 0 || ftx_init_libdvk_ncoredevice_dll() != 0 ||
        AtThreadStart() != 0) {
        fprintf(stderr, "channel_bench: the channel did not start\n");
        return 1;
    }
    int port = 0;
    for (int i = 0; i < 500 && port <= 0; i++) {
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
        std::ifstream in(std::string(root) + "/run/pc_port");
        in >> port;
    }
    std::thread echo;
    int echoPort = start_echo(echo);
    int chan = connect_to(port), bare = connect_to(echoPort);
    if (port <= 0 || echoPort <= 0 || chan < 0 || bare < 0) {
        fprintf(stderr, "channel_bench: cannot connect\n");
        return 1;
    }

    const int kRounds = 20, kPerRound = 250;
    std::string cbuf, ebuf;
    std::vector<double> chanT, echoT;
    for (int i = 0; i < 200; i++) {  // warm-up
        round_trip_us(chan, cbuf, channel_answer_size);
        round_trip_us(bare, ebuf, echo_answer_size);
    }
    // Interleaved rounds, so both see the same machine load.
    for (int r = 0; r < kRounds; r++) {
        for (int i = 0; i < kPerRound; i++)
            chanT.push_back(round_trip_us(chan, cbuf, channel_answer_size));
        for (int i = 0; i < kPerRound; i++)
            echoT.push_back(round_trip_us(bare, ebuf, echo_answer_size));
    }
    double c = median(chanT), e = median(echoT);

    // Sequential commands per second on one connection.
    auto t0 = Clock::now();
    const int kSeq = 5000;
    for (int i = 0; i < kSeq; i++)
        round_trip_us(chan, cbuf, channel_answer_size);
    double seqSecs = std::chrono::duration<double>(Clock::now() - t0).count();

    // Pipelined: many commands written at once, answers read as they come.
    const int kPipe = 5000;
    std::string batch;
    for (int i = 0; i < kPipe; i++)
        batch += kCommand;
    t0 = Clock::now();
    std::thread writer([&] {
        size_t off = 0;
        while (off < batch.size()) {
            ssize_t n = write(chan, batch.data() + off, batch.size() - off);
            if (n <= 0) break;
            off += static_cast<size_t>(n);
        }
    });
    int answered = 0;
    while (answered < kPipe) {
        if (!read_answer(chan, cbuf,
                         [](const std::string &b) { return channel_answer_size(b) != 0; }))
            break;
        while (size_t s = channel_answer_size(cbuf)) {
            cbuf.erase(0, s);
            answered++;
        }
    }
    writer.join();
    double pipeSecs = std::chrono::duration<double>(Clock::now() - t0).count();

    printf("channel round trip (\"testinfoMoudle testItem 5,read\"): median %.1f us\n", c);
    printf("bare TCP echo on loopback:                          median %.1f us\n", e);
    printf("ratio channel/echo: %.2f (target at most 1.5; log floor FTX_LOG_LEVEL=%s)\n", c / e,
           getenv("FTX_LOG_LEVEL"));
    printf("commands per second on one connection: %.0f one at a time, %.0f pipelined\n",
           kSeq / seqSecs, answered / pipeSecs);

    close(bare);
    echo.join();
    close(chan);
    std::error_code ec;
    std::filesystem::remove_all(root, ec);
    return 0;
}
