// Process control and the two channels of a device under test.
#include "support/device_under_test.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <signal.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <thread>

#include "support/host_io.h"

namespace fs = std::filesystem;

namespace {

int free_port() {
    int fd = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    bind(fd, reinterpret_cast<sockaddr *>(&a), sizeof a);
    socklen_t len = sizeof a;
    getsockname(fd, reinterpret_cast<sockaddr *>(&a), &len);
    close(fd);
    return ntohs(a.sin_port);
}

void set_timeouts(int fd, int seconds) {
    timeval tv{seconds, 0};
    setsockopt(fd, SOL_SOCKET, SO_RCVTIMEO, &tv, sizeof tv);
    setsockopt(fd, SOL_SOCKET, SO_SNDTIMEO, &tv, sizeof tv);
}

std::string slurp(const std::string &path) {
    std::ifstream in(path, std::ios::binary);
    return std::string((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
}

}  // namespace

bool dut_wait_until(const std::function<bool()> &pred, int timeoutMs) {
    auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
    while (std::chrono::steady_clock::now() < end) {
        if (pred()) return true;
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    return pred();
}

std::string DeviceUnderTest::sourceDir() {
    const char *s = getenv("FTX_SOURCE_DIR");
    return s ? s : ".";
}

std::string DeviceUnderTest::buildDir() {
    const char *s = getenv("FTX_BUILD_DIR");
    return s ? s : "build";
}

DeviceUnderTest::DeviceUnderTest() {
    char tmpl[] = "/tmp/ftx-dut-XXXXXX";
    root_ = mkdtemp(tmpl);
    fs::copy(sourceDir() + "/sim/image", root_, fs::copy_options::recursive);
    // What the build adds to the image (the calibration pictures).
    std::error_code ec;
    if (fs::is_directory(buildDir() + "/image", ec))
        fs::copy(buildDir() + "/image", root_,
                 fs::copy_options::recursive | fs::copy_options::overwrite_existing);
    fs::create_directories(root_ + "/log");
    fs::create_directories(root_ + "/run");
    port_ = free_port();
}

DeviceUnderTest::~DeviceUnderTest() {
    stop();
    std::error_code ec;
    if (!getenv("FTX_KEEP_ROOT")) fs::remove_all(root_, ec);
}

void DeviceUnderTest::write(const std::string &devicePath, const std::string &content) const {
    fs::path p(host(devicePath));
    fs::create_directories(p.parent_path());
    std::ofstream(p, std::ios::binary) << content;
}

std::string DeviceUnderTest::read(const std::string &devicePath) const {
    return slurp(host(devicePath));
}

bool DeviceUnderTest::exists(const std::string &devicePath) const {
    return fs::exists(host(devicePath));
}

void DeviceUnderTest::remove(const std::string &devicePath) const {
    std::error_code ec;
    fs::remove(host(devicePath), ec);
}

void DeviceUnderTest::setProperty(const std::string &name, const std::string &value) const {
    std::istringstream in(read("/sim/properties"));
    std::string line, out;
    while (std::getline(in, line))
        if (line.rfind(name + "=", 0) != 0) out += line + "\n";
    out += name + "=" + value + "\n";
    write("/sim/properties", out);
}

namespace {

// text with key=value in [section]: the key's line replaced, or added at the section's end
// (and, with addSection, the section added when missing); an empty value removes the key.
// Added lines end in eol; the others keep theirs.
std::string with_ini_key(const std::string &text, const std::string &section,
                         const std::string &key, const std::string &value, const char *eol,
                         bool addSection) {
    std::istringstream in(text);
    std::string line, out, current;
    bool done = false;
    auto add = [&] {
        if (!done && current == section && !value.empty()) out += key + "=" + value + eol;
        done = done || current == section;
    };
    while (std::getline(in, line)) {
        std::string bare = line;
        if (!bare.empty() && bare.back() == '\r') bare.pop_back();
        if (!bare.empty() && bare[0] == '[') {
            if (current == section) add();
            current = bare.substr(1, bare.find(']') - 1);
        } else if (current == section && bare.rfind(key + "=", 0) == 0) {
            add();
            continue;
        }
        out += line + "\n";
    }
    if (current == section) add();
    if (!done && addSection && !value.empty())
        out += "[" + section + "]" + eol + key + "=" + value + eol;
    return out;
}

}  // namespace

void DeviceUnderTest::setConfig(const std::string &domain, const std::string &key,
                                const std::string &value) const {
    write("/etc/ftx_config.ini",
          with_ini_key(read("/etc/ftx_config.ini"), domain, key, value, "\r\n", false));
}

void DeviceUnderTest::setDeviceIni(const std::string &section, const std::string &key,
                                   const std::string &value) const {
    write("/sim/device.ini",
          with_ini_key(read("/sim/device.ini"), section, key, value, "\n", true));
}

void DeviceUnderTest::setEnv(const std::string &name, const std::string &value) {
    env_.emplace_back(name, value);
}

void DeviceUnderTest::setScreen(int w, int h) {
    setEnv("FTX_SCREEN", std::to_string(w) + "x" + std::to_string(h));
}

bool DeviceUnderTest::start() {
    return spawn(false);
}

bool DeviceUnderTest::startLauncher() {
    return spawn(true);
}

bool DeviceUnderTest::spawn(bool launcher) {
    std::string exe = buildDir() + "/bin/ftx-mmi";
    std::string script = sourceDir() + "/tools/run.sh";
    std::string out = root_ + "/log/stdout.txt";
    pid_ = fork();
    if (pid_ < 0) return false;
    if (pid_ == 0) {
        setenv("FTX_ROOT", root_.c_str(), 1);
        setenv("FTX_DISPLAY", "headless", 1);
        setenv("FTX_PC_PORT", std::to_string(port_).c_str(), 1);
        setenv("LD_LIBRARY_PATH", (buildDir() + "/lib").c_str(), 1);
        setenv("FTX_TOP", sourceDir().c_str(), 1);
        for (const auto &e : env_)
            setenv(e.first.c_str(), e.second.c_str(), 1);
        int fd = open(out.c_str(), O_WRONLY | O_CREAT | O_APPEND, 0644);
        if (fd >= 0) {
            dup2(fd, 1);
            dup2(fd, 2);
            close(fd);
        }
        if (launcher)
            execl("/bin/bash", "bash", script.c_str(), "--root", root_.c_str(), "--headless",
                  static_cast<char *>(nullptr));
        else
            execl(exe.c_str(), "ftx-mmi", static_cast<char *>(nullptr));
        _exit(127);
    }
    status_ = -1;
    return true;
}

bool DeviceUnderTest::waitConsole(int timeoutMs) {
    return dut_wait_until(
               [&] {
                   if (!running()) return true;
                   return console("help").find("OK") != std::string::npos;
               },
               timeoutMs) &&
           running();
}

bool DeviceUnderTest::startToMenu(int timeoutMs) {
    if (!start() || !waitConsole(timeoutMs)) return false;
    // The menu is up once its soft-key bar exists.
    if (!dut_wait_until([&] { return console("windows").find("softkeybar") != std::string::npos; },
                        timeoutMs))
        return false;
    // The channel's thread is started before the menu, when it is started at all.
    return logPos("AtThreadStart end") == std::string::npos || waitChannel(timeoutMs);
}

bool DeviceUnderTest::waitChannel(int timeoutMs) const {
    // The command callback is registered once the socket listens.
    return dut_wait_until(
        [&] { return console("hw status").find("registerCommandProcess(") != std::string::npos; },
        timeoutMs);
}

std::string DeviceUnderTest::console(const std::string &line) const {
    int fd = socket(AF_UNIX, SOCK_STREAM, 0);
    if (fd < 0) return "";
    sockaddr_un a{};
    a.sun_family = AF_UNIX;
    std::string path = root_ + "/run/console.sock";
    strncpy(a.sun_path, path.c_str(), sizeof a.sun_path - 1);
    set_timeouts(fd, 10);
    if (connect(fd, reinterpret_cast<sockaddr *>(&a), sizeof a) != 0 ||
        !send_all(fd, line + "\n")) {
        close(fd);
        return "";
    }
    std::string reply, pending;
    char buf[4096];
    for (;;) {
        ssize_t n = recv(fd, buf, sizeof buf, 0);
        if (n <= 0) break;
        pending.append(buf, static_cast<size_t>(n));
        size_t nl;
        bool last = false;
        while ((nl = pending.find('\n')) != std::string::npos) {
            std::string l = pending.substr(0, nl);
            pending.erase(0, nl + 1);
            reply += l + "\n";
            if (l == "OK" || l.rfind("KO", 0) == 0) last = true;
        }
        if (last) break;
    }
    close(fd);
    return reply;
}

bool DeviceUnderTest::consoleOk(const std::string &line) const {
    std::string r = console(line);
    return r.size() >= 3 && r.compare(r.size() - 3, 3, "OK\n") == 0;
}

bool DeviceUnderTest::waitDialogTakesKeys(int timeoutMs) const {
    const std::string seen = "1203 Dialog hookKeyProc enter,msg=18,wparam=200,";
    size_t before = logCount(seen);
    return dut_wait_until(
        [&] { return consoleOk("key up 200") && waitLogCount(seen, before + 1, 200); }, timeoutMs);
}

std::pair<int, std::string> DeviceUnderTest::pc(const std::string &line) const {
    int fd = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_port = htons(static_cast<uint16_t>(port_));
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    set_timeouts(fd, 30);
    if (connect(fd, reinterpret_cast<sockaddr *>(&a), sizeof a) != 0 ||
        !send_all(fd, line + "\n")) {
        close(fd);
        return {-1, ""};
    }
    std::string data;
    char buf[4096];
    int result = -1;
    size_t want = 0, headerEnd = std::string::npos;
    for (;;) {
        ssize_t n = recv(fd, buf, sizeof buf, 0);
        if (n <= 0) break;
        data.append(buf, static_cast<size_t>(n));
        if (headerEnd == std::string::npos && (headerEnd = data.find('\n')) != std::string::npos) {
            result = atoi(data.c_str());
            want = strtoul(data.c_str() + data.find(' ') + 1, nullptr, 10);
        }
        if (headerEnd != std::string::npos && data.size() >= headerEnd + 1 + want + 1) break;
    }
    close(fd);
    if (headerEnd == std::string::npos) return {-1, ""};
    return {result, data.substr(headerEnd + 1, want)};
}

std::string DeviceUnderTest::logcat() const {
    // The log is a ring: logcat.txt.N (oldest) ... logcat.txt.1, then logcat.txt. The newest
    // is read first, so a rotation while reading repeats lines rather than losing them; a
    // changed logcat.txt afterwards means one happened, and the whole is read again.
    const std::string base = host("/log/logcat.txt");
    auto inode = [&] {
        struct stat st;
        return stat(base.c_str(), &st) == 0 ? st.st_ino : 0;
    };
    std::string all;
    for (int attempt = 0; attempt < 5; attempt++) {
        ino_t before = inode();
        all = slurp(base);
        // Every number the ring allows: a rotation renames the older files one by one.
        for (int i = 1; i <= 99; i++) {
            std::string older = base + "." + std::to_string(i);
            if (fs::exists(older)) all.insert(0, slurp(older));
        }
        if (inode() == before) break;
    }
    return all;
}

size_t DeviceUnderTest::logPos(const std::string &text) const {
    return logcat().find(text);
}

bool DeviceUnderTest::waitLog(const std::string &text, int timeoutMs) const {
    return dut_wait_until([&] { return logPos(text) != std::string::npos; }, timeoutMs);
}

size_t DeviceUnderTest::logCount(const std::string &text) const {
    std::string log = logcat();
    size_t n = 0;
    for (size_t p = log.find(text); p != std::string::npos; p = log.find(text, p + text.size()))
        n++;
    return n;
}

bool DeviceUnderTest::waitLogCount(const std::string &text, size_t n, int timeoutMs) const {
    return dut_wait_until([&] { return logCount(text) >= n; }, timeoutMs);
}

long DeviceUnderTest::batteryRounds() const {
    std::string s = console("hw status");
    size_t p = s.find(" rounds=");
    return p == std::string::npos ? -1 : atol(s.c_str() + p + 8);
}

bool DeviceUnderTest::waitBatteryRounds(long n, int timeoutMs) {
    long from = batteryRounds();
    if (from < 0) return false;
    // One round may be under way: it could have begun before what the caller just did.
    return dut_wait_until([&] { return !running() || batteryRounds() >= from + n + 1; },
                          timeoutMs) &&
           running();
}

bool DeviceUnderTest::running() {
    if (pid_ <= 0) return false;
    int st;
    pid_t r = waitpid(pid_, &st, WNOHANG);
    if (r == pid_) {
        status_ = WIFEXITED(st) ? WEXITSTATUS(st) : 128 + WTERMSIG(st);
        pid_ = -1;
        return false;
    }
    return r == 0;
}

int DeviceUnderTest::wait(int timeoutMs) {
    if (pid_ > 0 && !dut_wait_until([&] { return !running(); }, timeoutMs)) return -1;
    return status_;
}

void DeviceUnderTest::stop() {
    if (pid_ <= 0) return;
    kill(pid_, SIGTERM);
    if (wait(3000) == -1 && pid_ > 0) {
        kill(pid_, SIGKILL);
        wait(3000);
    }
}
