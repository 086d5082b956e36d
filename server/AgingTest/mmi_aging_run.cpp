#include "AgingTest/mmi_aging_run.h"

#include <android/log.h>
#include <stdarg.h>
#include <stdio.h>
#include <string.h>
#include <time.h>
#include <unistd.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>

#include "AgingTest/mmi_aging_config.h"
#include "AgingTest/mmi_aging_upload.h"
#include "AgingTest/mmi_aging_window.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_power.h"
#include "core/mmi_rtc_alarm.h"
#include "core/mmi_settings.h"
#include "devfs.h"
#include "ftx_log.h"
#include "screens/mmi_identity.h"
#include "tp_os.h"

#define AGING_TAG "AgingTest"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, AGING_TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, AGING_TAG, __VA_ARGS__)

namespace {

using Clock = std::chrono::steady_clock;

// Fixed parts of the items that have no setting of their own.
const int kAudioMinutes = 5;         // the ring tone plays this long
const int kStandbySeconds = 30;      // each standby sleeps this long (the RTC alarm)
const int kAwakeSeconds = 10;        // and the handset stays awake this long after it
const int kCameraRoundGapMs = 1000;  // between two rounds of camera checks
const int kBetweenItemsMs = 2000;    // the screen shows the counts between items
const int kRebootGraceMs = 3000;     // the log and the screen settle before a reboot
const int kSliceMs = 250;            // a wait looks at the stop and the battery this often
const int kRingType = 0;             // the loudspeaker's tone

std::mutex s_lock;  // the view below and the thread's life
std::condition_variable s_changed;
mmi_aging_view s_view;
bool s_alive = false;
std::atomic<int> s_stopAsked{0};
Clock::time_point s_resumedAt;  // when this process took the run over
long long s_elapsedBase = 0;    // seconds of run time before it did
FILE *s_log = nullptr;          // the aging log

// ---- the view and the log ----

template <typename F>
void update(F f) {
    std::lock_guard<std::mutex> lk(s_lock);
    f(s_view);
}

void event(const char *fmt, ...) __attribute__((format(printf, 1, 2)));
void event(const char *fmt, ...) {
    char text[512];
    va_list ap;
    va_start(ap, fmt);
    vsnprintf(text, sizeof text, fmt, ap);
    va_end(ap);
    LOGD("%s", text);
    if (s_log != nullptr) writeftxlog(s_log, AGING_TAG, "%s", text);
}

long long now_epoch() {
    return static_cast<long long>(time(nullptr));
}

long long elapsed_now() {
    return s_elapsedBase +
           std::chrono::duration_cast<std::chrono::seconds>(Clock::now() - s_resumedAt).count();
}

bool stop_asked() {
    return s_stopAsked.load() != 0;
}

// ---- the record ----

mmi_aging_record &rec() {
    return s_view.record;  // written by the run thread only, read under s_lock
}

void save_marker() {
    char path[MMI_TEXT_SIZE];
    mmi_aging_marker_path(path, sizeof path);
    mmi_aging_record copy;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        rec().elapsed = elapsed_now();
        copy = rec();
    }
    if (mmi_aging_record_save(&copy, path) != 0) LOGE("cannot write the marker %s", path);
}

// Counts a step of the item in progress and keeps the record.
void count(int item, bool passed, const char *failure) {
    update([&](mmi_aging_view &v) {
        mmi_aging_record_count(&v.record, item, passed ? 1 : 0, failure);
    });
    if (!passed)
        event("cycle %d %s failed: %s", rec().cycle + 1, mmi_aging_item_name(item),
              failure != nullptr ? failure : "");
}

// ---- the upload ----

// Keeps the record for the server and sends what is kept; a server that is down keeps
// everything for the next try.
void upload(bool keepRecord) {
    if (!g_bAging_SaveDb) return;
    char dir[MMI_TEXT_SIZE];
    mmi_aging_upload_dir(dir, sizeof dir);
    if (keepRecord) {
        char barcode[MMI_IDENTITY_TEXT_SIZE] = "", version[MMI_IDENTITY_TEXT_SIZE] = "";
        mmi_AutoTest_barcode_Read(barcode, sizeof barcode);
        mmi_AutoTest_internalsoftware_Read(version, sizeof version);
        mmi_aging_record copy;
        {
            std::lock_guard<std::mutex> lk(s_lock);
            rec().elapsed = elapsed_now();
            rec().uploadedAt = now_epoch();
            copy = rec();
        }
        static char json[8192];
        // The readers answer "*" and the value.
        const char *code = barcode[0] == '*' ? barcode + 1 : barcode;
        const char *ver = version[0] == '*' ? version + 1 : version;
        if (mmi_aging_record_json(&copy, code, ver, json, sizeof json) < 0 ||
            mmi_aging_upload_keep(dir, json) != 0)
            event("upload: the record could not be kept");
    }
    if (mmi_aging_upload_pending(dir) <= 0) return;
    const int sent = mmi_aging_upload_flush(dir, g_iport);
    if (sent < 0)
        event("upload to %s failed, %d record(s) kept for the next try", g_iport,
              mmi_aging_upload_pending(dir));
    else
        event("upload: %d record(s) sent to %s", sent, g_iport);
}

// ---- the battery watch ----

// Refreshes the battery values of the view; when the battery is too warm, stops charging
// and waits until it has cooled down (or a stop). False when stopped.
bool battery_watch() {
    FTX_BATTERY_INFO info;
    const bool known = mmi_battery_snapshot(&info) == 0;
    update([&](mmi_aging_view &v) {
        v.batteryLevel = known ? info.batteryLevel : -1;
        v.batteryTemp = known ? info.batteryTemperature : 0;
    });
    if (g_bAging_ExternalBattery || !known || info.batteryTemperature <= g_iAgingTempUpLimit)
        return !stop_asked();
    int before = AGING_PHASE_ITEM;
    update([&](mmi_aging_view &v) {
        before = v.phase;
        v.phase = AGING_PHASE_HOT;
    });
    event("battery %d above %d: charging off, paused", info.batteryTemperature,
          g_iAgingTempUpLimit);
    if (hw::FTX_API_BatteryService_ChargingStatusSet)
        hw::FTX_API_BatteryService_ChargingStatusSet(0);
    int temp = info.batteryTemperature;
    while (!stop_asked()) {
        {
            std::unique_lock<std::mutex> lk(s_lock);
            s_changed.wait_for(lk, std::chrono::milliseconds(kSliceMs),
                               [] { return stop_asked(); });
        }
        if (mmi_battery_snapshot(&info) != 0) continue;
        temp = info.batteryTemperature;
        update([&](mmi_aging_view &v) {
            v.batteryLevel = info.batteryLevel;
            v.batteryTemp = temp;
        });
        if (temp < g_iAgingTempUncharge) break;
    }
    if (hw::FTX_API_BatteryService_ChargingStatusSet)
        hw::FTX_API_BatteryService_ChargingStatusSet(1);
    update([&](mmi_aging_view &v) { v.phase = before; });
    if (!stop_asked())
        event("battery %d below %d: charging on, going on", temp, g_iAgingTempUncharge);
    return !stop_asked();
}

// ---- waits ----

// Waits ms of scaled time, keeping the view's time left and the battery watch; false when
// the run was stopped. A pause for the battery does not count as time waited.
bool wait_scaled_ms(long long ms, bool showLeft) {
    const double scale = tp_os_time_scale();
    long long leftReal = static_cast<long long>(ms * scale);
    while (leftReal > 0) {
        if (showLeft) {
            const int left = static_cast<int>((leftReal / scale + 999) / 1000);
            update([&](mmi_aging_view &v) { v.itemLeft = left; });
        }
        const long long slice = leftReal < kSliceMs ? leftReal : kSliceMs;
        const Clock::time_point from = Clock::now();
        {
            std::unique_lock<std::mutex> lk(s_lock);
            if (s_changed.wait_for(lk, std::chrono::milliseconds(slice),
                                   [] { return stop_asked(); }))
                return false;
        }
        leftReal -=
            std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - from).count();
        if (!battery_watch()) return false;
    }
    if (showLeft) update([&](mmi_aging_view &v) { v.itemLeft = 0; });
    return !stop_asked();
}

bool wait_minutes(int minutes) {
    return wait_scaled_ms(static_cast<long long>(minutes) * 60000, true);
}

// ---- the items ----

// The result of one step: passed, failed, or cut short by a stop (not counted).
enum StepResult { STEP_PASS, STEP_FAIL, STEP_CUT };

StepResult detect(int (*fn)(void), const char *name, char *why, size_t size) {
    if (fn == nullptr) {
        snprintf(why, size, "%s: not in the library", name);
        return STEP_FAIL;
    }
    const int rc = fn();
    snprintf(why, size, "%s returned %d", name, rc);
    return rc == 0 ? STEP_PASS : STEP_FAIL;
}

StepResult step_wifi(int, char *why, size_t size) {
    return detect(hw::ftx_api_WifiDevDetect, "ftx_api_WifiDevDetect", why, size);
}
StepResult step_bt(int, char *why, size_t size) {
    return detect(hw::ftx_api_BTDevDetect, "ftx_api_BTDevDetect", why, size);
}
StepResult step_fm(int, char *why, size_t size) {
    return detect(hw::ftx_api_FMDevDetect, "ftx_api_FMDevDetect", why, size);
}

StepResult step_video(int, char *, size_t) {
    update([](mmi_aging_view &v) { v.video = 1; });
    const bool done = wait_minutes(g_iAgingVedioTestTime);
    update([](mmi_aging_view &v) { v.video = 0; });
    return done ? STEP_PASS : STEP_CUT;
}

StepResult step_light(int, char *why, size_t size) {
    const int rc = hw::ftx_api_AlllightTest_Start();
    const bool done = wait_minutes(g_iAgingLightTime);
    hw::ftx_api_AlllightTest_Stop();
    if (!done) return STEP_CUT;
    snprintf(why, size, "ftx_api_AlllightTest_Start returned %d", rc);
    return rc == 0 ? STEP_PASS : STEP_FAIL;
}

// One round over the cameras; each camera's check is counted by itself.
StepResult step_camera(int round, char *, size_t) {
    for (int id = 0; id < g_iCameraTotalNum; id++) {
        const int rc = hw::ftx_api_cameraID_test(id);
        char why[MMI_AGING_FAILURE_SIZE];
        snprintf(why, sizeof why, "camera %d check returned %d", id, rc);
        count(AGING_ITEM_CAMERA, rc == 0, why);
    }
    return round + 1 < g_iAgingCameraTotalNum && !wait_scaled_ms(kCameraRoundGapMs, false)
               ? STEP_CUT
               : STEP_PASS;
}

StepResult step_vibrator(int, char *why, size_t size) {
    if (!hw::ftx_api_Vibrator_Test_Start) {
        snprintf(why, size, "the vibrator is not in the library");
        return STEP_FAIL;
    }
    const int rc = hw::ftx_api_Vibrator_Test_Start(-1);
    const bool done = wait_minutes(g_iAgingVibratorTime);
    if (hw::ftx_api_Vibrator_Test_Stop) hw::ftx_api_Vibrator_Test_Stop();
    if (!done) return STEP_CUT;
    snprintf(why, size, "ftx_api_Vibrator_Test_Start returned %d", rc);
    return rc == 0 ? STEP_PASS : STEP_FAIL;
}

StepResult step_audio(int, char *why, size_t size) {
    const int rc = hw::ftx_api_Audio_RingTest_Start(kRingType);
    const bool done = wait_minutes(kAudioMinutes);
    hw::ftx_api_Audio_RingTest_Stop(kRingType);
    if (!done) return STEP_CUT;
    snprintf(why, size, "ftx_api_Audio_RingTest_Start returned %d", rc);
    return rc == 0 ? STEP_PASS : STEP_FAIL;
}

// ---- the full CPU load: one busy thread per core ----

std::atomic<int> s_spinStop{0};
std::atomic<int> s_spinners{0};
std::mutex s_spinLock;
std::condition_variable s_spinDone;

void *spin(void *) {
    volatile unsigned long long x = 0;
    while (s_spinStop.load(std::memory_order_relaxed) == 0)
        for (int i = 0; i < 100000; i++)
            x = x * 6364136223846793005ULL + 1442695040888963407ULL;
    std::lock_guard<std::mutex> lk(s_spinLock);
    s_spinners--;
    s_spinDone.notify_all();
    return nullptr;
}

StepResult step_cpu(int, char *why, size_t size) {
    long cores = sysconf(_SC_NPROCESSORS_ONLN);
    if (cores < 1) cores = 1;
    s_spinStop = 0;
    int started = 0;
    for (long i = 0; i < cores; i++) {
        s_spinners++;
        if (tp_os_thread_create("AGING_CPU", 0, 0, spin, nullptr) == 0) {
            s_spinners--;
            continue;
        }
        started++;
    }
    event("cpu: %d busy thread(s) for %d minute(s)", started, g_cputime);
    const bool done = wait_minutes(g_cputime);
    s_spinStop = 1;
    {
        std::unique_lock<std::mutex> lk(s_spinLock);
        s_spinDone.wait(lk, [] { return s_spinners.load() == 0; });
    }
    if (!done) return STEP_CUT;
    snprintf(why, size, "%d of %ld busy threads started", started, cores);
    return started == cores ? STEP_PASS : STEP_FAIL;
}

StepResult step_standby(int, char *why, size_t size) {
    update([](mmi_aging_view &v) { v.phase = AGING_PHASE_STANDBY; });
    const Clock::time_point from = Clock::now();
    int rc = mmi_rtc_set_wakealarm(kStandbySeconds);
    if (rc == 0) rc = mmi_system_suspend();
    FTX_API_SetIdleStatus();  // the screen comes back
    update([](mmi_aging_view &v) { v.phase = AGING_PHASE_ITEM; });
    const long long slept =
        std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - from).count();
    event("standby: resumed after %lld ms (rc %d)", slept, rc);
    if (rc != 0) {
        snprintf(why, size, "standby failed (%d)", rc);
        return STEP_FAIL;
    }
    return wait_scaled_ms(kAwakeSeconds * 1000LL, false) ? STEP_PASS : STEP_CUT;
}

StepResult step_reboot(int, char *why, size_t size) {
    update([](mmi_aging_view &v) {
        v.phase = AGING_PHASE_REBOOT;
        v.record.rebootPending = 1;
    });
    save_marker();
    event("reboot %d of %d, cycle %d", rec().step + 1, g_iAgingTotalRebootNum, rec().cycle + 1);
    if (!wait_scaled_ms(kRebootGraceMs, false)) {
        update([](mmi_aging_view &v) { v.record.rebootPending = 0; });
        return STEP_CUT;
    }
    sync();
    dev_reboot(LINUX_REBOOT_CMD_RESTART);
    // Still here: the reboot did not happen.
    update([](mmi_aging_view &v) {
        v.phase = AGING_PHASE_ITEM;
        v.record.rebootPending = 0;
    });
    snprintf(why, size, "the reboot did not happen");
    return STEP_FAIL;
}

int one() {
    return 1;
}
int camera_rounds() {
    return g_iAgingCameraTotalNum;
}
int standby_cycles() {
    return g_iAgingSuspendTotalNum;
}
int reboots() {
    return g_iAgingTotalRebootNum;
}

struct Item {
    int id;
    const int *enabled;  // null: every cycle
    int (*steps)(void);  // steps in a cycle
    StepResult (*step)(int index, char *why, size_t size);
    bool countsItself;  // the step counts its own checks
};

// In the order they run.
const Item kItems[] = {
    {AGING_ITEM_WIFI_DETECT, nullptr, one, step_wifi, false},
    {AGING_ITEM_BT_DETECT, nullptr, one, step_bt, false},
    {AGING_ITEM_FM_DETECT, nullptr, one, step_fm, false},
    {AGING_ITEM_VIDEO, &g_bAging_VedioTest, one, step_video, false},
    {AGING_ITEM_LIGHT, &g_bAging_LightTest, one, step_light, false},
    {AGING_ITEM_CAMERA, &g_bAging_CameraTest, camera_rounds, step_camera, true},
    {AGING_ITEM_VIBRATOR, &g_bAging_VibratorTest, one, step_vibrator, false},
    {AGING_ITEM_AUDIO, &g_bAging_AudioLoop, one, step_audio, false},
    {AGING_ITEM_CPU, &g_bAging_CpuFullLoad, one, step_cpu, false},
    {AGING_ITEM_STANDBY, &g_bAging_SuspendTest, standby_cycles, step_standby, false},
    {AGING_ITEM_REBOOT, &g_bAging_RebootTest, reboots, step_reboot, false},
};
static_assert(sizeof kItems / sizeof kItems[0] == AGING_ITEM_COUNT, "one row per item");

// Runs the item's remaining steps of this cycle; false when the run was stopped.
bool run_item(const Item &it) {
    const int steps = it.steps();
    update([&](mmi_aging_view &v) {
        v.phase = AGING_PHASE_ITEM;
        v.itemSteps = steps > 1 ? steps : 0;
        v.itemLeft = -1;
    });
    if (rec().step == 0) event("cycle %d: %s begins", rec().cycle + 1, mmi_aging_item_name(it.id));
    while (rec().step < steps) {
        if (!battery_watch()) return false;
        char why[MMI_AGING_FAILURE_SIZE] = "";
        const StepResult r = it.step(rec().step, why, sizeof why);
        if (r == STEP_CUT) return false;
        if (!it.countsItself) count(it.id, r == STEP_PASS, why);
        update([](mmi_aging_view &v) { v.record.step++; });
        save_marker();
    }
    update([](mmi_aging_view &v) { v.itemLeft = -1; });
    event("cycle %d: %s done (%d passed, %d failed)", rec().cycle + 1, mmi_aging_item_name(it.id),
          rec().counts[it.id].pass, rec().counts[it.id].fail);
    return true;
}

bool enabled(const Item &it) {
    return it.enabled == nullptr || *it.enabled != 0;
}

// Moves on to the next item (and cycle) and keeps the record.
void next_item() {
    update([](mmi_aging_view &v) {
        mmi_aging_record &r = v.record;
        r.step = 0;
        if (++r.item >= AGING_ITEM_COUNT) {
            r.item = 0;
            r.cycle++;
        }
    });
    save_marker();
}

// Takes the record over from the marker, or starts a new one.
void begin_record() {
    char path[MMI_TEXT_SIZE];
    mmi_aging_marker_path(path, sizeof path);
    mmi_aging_record r;
    const bool resumed = mmi_aging_record_load(&r, path) == 0;
    if (!resumed) mmi_aging_record_init(&r, g_iAgingCycles, now_epoch());
    if (r.rebootPending) {
        // The handset came back from the reboot the run asked for.
        r.rebootPending = 0;
        mmi_aging_record_count(&r, AGING_ITEM_REBOOT, 1, nullptr);
        r.step++;
    }
    update([&](mmi_aging_view &v) {
        v = mmi_aging_view{};
        v.record = r;
        v.phase = AGING_PHASE_STARTING;
        v.itemLeft = -1;
        v.batteryLevel = -1;
    });
    s_resumedAt = Clock::now();
    s_elapsedBase = r.elapsed;
    if (resumed)
        event("resumed: cycle %d of %d, %s step %d, %d failure(s)", r.cycle + 1, r.cycles,
              mmi_aging_item_name(r.item), r.step, r.failures);
    else
        event("started: %d cycle(s)", r.cycles);
    save_marker();
}

// The end: the record becomes the result, the marker goes.
void finish(bool stopped) {
    update([&](mmi_aging_view &v) {
        v.phase = AGING_PHASE_DONE;
        v.video = 0;
        v.itemLeft = -1;
        v.record.finished = 1;
        v.record.stopped = stopped ? 1 : 0;
    });
    save_marker();
    upload(true);
    char marker[MMI_TEXT_SIZE], result[MMI_TEXT_SIZE];
    mmi_aging_marker_path(marker, sizeof marker);
    mmi_aging_result_path(result, sizeof result);
    mmi_aging_record copy;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        copy = rec();
    }
    if (mmi_aging_record_save(&copy, result) != 0) LOGE("cannot write the result %s", result);
    dev_unlink(marker);
    event("%s: %d cycle(s), %d failure(s), %lld s", stopped ? "stopped" : "finished", copy.cycle,
          copy.failures, copy.elapsed);
}

void run() {
    begin_record();
    upload(false);  // what an earlier run could not send
    const long long uploadEveryMs = static_cast<long long>(g_iAgingSaveDbTime) * 60000;
    Clock::time_point lastUpload = Clock::now();
    while (!stop_asked() && rec().cycle < rec().cycles && !rec().finished) {
        const int cycleBefore = rec().cycle;
        const Item &it = kItems[rec().item];
        if (enabled(it)) {
            if (!run_item(it)) break;
            update([](mmi_aging_view &v) {
                v.phase = AGING_PHASE_BETWEEN;
                v.itemSteps = 0;
            });
            if (!wait_scaled_ms(kBetweenItemsMs, false)) {
                next_item();
                break;
            }
        }
        next_item();
        const double scale = tp_os_time_scale();
        const bool due =
            uploadEveryMs > 0 &&
            Clock::now() - lastUpload >=
                std::chrono::milliseconds(static_cast<long long>(uploadEveryMs * scale));
        if (due) {
            lastUpload = Clock::now();
            upload(true);
        } else if (rec().cycle != cycleBefore) {
            upload(false);  // the retry of the next cycle
        }
    }
    finish(stop_asked());
}

}  // namespace

void mmi_aging_marker_path(char *out, size_t size) {
    snprintf(out, size, "%s%s", g_chLogPath, "rebootAging.txt");
}

void mmi_aging_result_path(char *out, size_t size) {
    snprintf(out, size, "%s%s", g_chAgingLogPath, "result.ini");
}

void mmi_aging_upload_dir(char *out, size_t size) {
    snprintf(out, size, "%s%s", g_chAgingLogPath, "upload");
}

void *mmi_AgingTest_Thread(void *) {
    if (init_ftx_log(&s_log, g_chAgingLogPath, "aging.log") != 0) s_log = nullptr;
    run();
    if (s_log != nullptr) uninit_ftxlog(s_log);
    s_log = nullptr;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        s_alive = false;
    }
    s_changed.notify_all();
    mmi_aging_window_finished();
    return nullptr;
}

int mmi_aging_run_begin(void) {
    std::lock_guard<std::mutex> lk(s_lock);
    if (s_alive) return -1;
    s_alive = true;
    s_stopAsked = 0;
    s_view = mmi_aging_view{};
    s_view.phase = AGING_PHASE_STARTING;
    s_view.itemLeft = -1;
    s_view.batteryLevel = -1;
    return 0;
}

void mmi_aging_run_abandon(void) {
    std::lock_guard<std::mutex> lk(s_lock);
    s_alive = false;
}

void mmi_aging_view_get(mmi_aging_view *out) {
    std::lock_guard<std::mutex> lk(s_lock);
    *out = s_view;
    if (s_alive && s_view.phase != AGING_PHASE_DONE) out->record.elapsed = elapsed_now();
}

int mmi_aging_run_active(void) {
    std::lock_guard<std::mutex> lk(s_lock);
    return s_alive ? 1 : 0;
}

int mmi_aging_run_stop(void) {
    std::unique_lock<std::mutex> lk(s_lock);
    if (!s_alive) return -1;
    s_stopAsked = 1;
    s_changed.notify_all();
    // The step in flight ends first; a standby in progress ends at its alarm.
    s_changed.wait_for(lk, std::chrono::seconds(5), [] { return !s_alive; });
    return 0;
}
