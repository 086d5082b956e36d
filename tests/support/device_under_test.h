// The real ftx-mmi, headless, in a private device root copied from sim/image: start it with
// a free PC port, talk to its emulator console and its PC channel, read its log, stop it.
// Integration tests of every area share it.
#pragma once

#include <sys/types.h>

#include <functional>
#include <string>
#include <utility>
#include <vector>

class DeviceUnderTest {
  public:
    // Makes the root (not started yet). FTX_SOURCE_DIR and FTX_BUILD_DIR locate the image
    // and the build.
    DeviceUnderTest();
    ~DeviceUnderTest();  // stops the process, removes the root
    DeviceUnderTest(const DeviceUnderTest &) = delete;
    DeviceUnderTest &operator=(const DeviceUnderTest &) = delete;

    const std::string &root() const { return root_; }
    std::string host(const std::string &devicePath) const { return root_ + devicePath; }
    int port() const { return port_; }

    // Files of the device root (before or while running).
    void write(const std::string &devicePath, const std::string &content) const;
    std::string read(const std::string &devicePath) const;
    bool exists(const std::string &devicePath) const;
    void remove(const std::string &devicePath) const;
    // Sets a property of sim/properties (read at start).
    void setProperty(const std::string &name, const std::string &value) const;
    // Sets key=value in [domain] of /etc/ftx_config.ini (CR LF kept); an empty value
    // removes the key.
    void setConfig(const std::string &domain, const std::string &key,
                   const std::string &value) const;
    // The same in the simulated handset's sim/device.ini (LF; a missing section is added).
    void setDeviceIni(const std::string &section, const std::string &key,
                      const std::string &value) const;

    // Extra environment for the process (FTX_TIME_SCALE, LD_LIBRARY_PATH, ...), before start.
    void setEnv(const std::string &name, const std::string &value);
    void setScreen(int w, int h);

    // Starts ftx-mmi; true once started (the console is not awaited).
    bool start();
    // Starts it through the launcher, tools/run.sh (as ./ftx run --headless does), which then
    // is the process: its standard error and the application's go to /log/stdout.txt, and
    // stop() ends both.
    bool startLauncher();
    // Waits until the console answers; false when the process ended or time ran out.
    bool waitConsole(int timeoutMs = 10000);
    // Starts and waits for the console, for the main menu's window and, when the
    // application starts the PC channel, for the channel to take commands.
    bool startToMenu(int timeoutMs = 15000);
    // Waits until the PC channel takes commands: the application opens it on a thread of
    // its own, which may come after the menu.
    bool waitChannel(int timeoutMs = 10000) const;

    // One console request; the reply lines, the last being "OK" or "KO ...".
    std::string console(const std::string &line) const;
    bool consoleOk(const std::string &line) const;
    // Waits until the dialog that is up takes the keys. Its key hook is installed after the
    // dialog shows, so a key sent as soon as the dialog is seen may still reach the window
    // behind it: a key-up nobody uses is sent until the dialog's hook logs one.
    bool waitDialogTakesKeys(int timeoutMs = 10000) const;
    // One PC command: the channel's result (0, 2, 3; -1 on a transport failure) and reply.
    std::pair<int, std::string> pc(const std::string &line) const;

    std::string logcat() const;
    // Waits until the log holds text (polls); true when it does.
    bool waitLog(const std::string &text, int timeoutMs = 10000) const;
    // Index of text in the log, or npos.
    size_t logPos(const std::string &text) const;
    // How many times text is in the log; waits until it is there at least n times.
    size_t logCount(const std::string &text) const;
    bool waitLogCount(const std::string &text, size_t n, int timeoutMs = 10000) const;

    // Rounds of the battery service whose observer callbacks have all returned (-1 when the
    // console does not tell). The application's idle check runs once a round, so "n more
    // rounds" is the condition to wait on where a rule must have had its chance to act.
    long batteryRounds() const;
    // Waits until n rounds after the current one have ended; false when the process ended
    // first or time ran out.
    bool waitBatteryRounds(long n, int timeoutMs = 20000);

    bool running();
    // Waits for the process to end: its exit status, or -1 on time-out (still running).
    int wait(int timeoutMs);
    void stop();
    pid_t pid() const { return pid_; }

    static std::string sourceDir();
    static std::string buildDir();

  private:
    bool spawn(bool launcher);

    std::string root_;
    int port_ = 0;
    pid_t pid_ = -1;
    int status_ = -1;
    std::vector<std::pair<std::string, std::string>> env_;
};

// Polls pred every 10 ms until it holds or timeoutMs passes.
bool dut_wait_until(const std::function<bool()> &pred, int timeoutMs);
