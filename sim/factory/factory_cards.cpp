// Card and peripheral area of the factory model: the SIM and SD cards in their slots, the
// device plugged in over USB OTG, and what the NFC reader and the fingerprint sensor are
// shown. The OTG, NFC and fingerprint tests hear only from the console's words (a device
// plugged, a tag, a finger), never by themselves, except that a device already plugged
// when the OTG test starts is reported at once.
#include <mutex>
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

const char kOtgStart[] = "ftx_api_USB_OTG_Test_START";
const char kNfcStart[] = "ftx_api_NFC_Start";
const char kFingerStart[] = "ftx_api_FingerPrintTest_Start";

// Longest tag identifier the reader reports (hex digits, colons or dashes).
constexpr size_t kUidMax = 32;

struct Cards {
    int sim[4] = {1, 1, 0, 0};
    int sd = 1;
    long sdSizeMb = 15193;
    int otg = 0;         // a device plugged
    std::string nfcUid;  // the last tag shown, "" none
    std::string finger;  // the last finger: "good", "bad" or ""
};

Cards &cards() {
    return model_part<Cards>();
}

// This area's part of "hw status".
void state(Reply &r) {
    const Cards &s = cards();
    r.add(" sim=%d,%d,%d,%d sd=%d sd.size=%ld otg=%s nfc=%s finger=%s", s.sim[0], s.sim[1],
          s.sim[2], s.sim[3], s.sd, s.sdSizeMb, s.otg ? "plugged" : "unplugged",
          s.nfcUid.empty() ? "-" : s.nfcUid.c_str(), s.finger.empty() ? "-" : s.finger.c_str());
}

Event reply(const std::string &op) {
    if (op != kOtgStart) return no_event();
    std::lock_guard<std::mutex> lock(model_lock());
    return cards().otg ? Event{FTX_DATATYPE_OTG, "result=pass"} : no_event();
}

bool uid_ok(const std::string &uid) {
    if (uid.empty() || uid.size() > kUidMax) return false;
    for (char c : uid) {
        const bool hex = (c >= '0' && c <= '9') || (c >= 'A' && c <= 'F') || (c >= 'a' && c <= 'f');
        if (!hex && c != ':' && c != '-') return false;
    }
    return true;
}

// One event to the test that op started, when it was started; "sent" or "no test" in the reply.
int send_to(const char *op, int datatype, const std::string &text, Reply &r) {
    ftx_api_module_cb cb = callback_of(op);
    deliver(cb, datatype, text, true);
    return r.done("%s %s\n", cb != nullptr ? "sent" : "no test for", text.c_str());
}

}  // namespace

int FactoryModel::sim_present(int slot) {
    std::lock_guard<std::mutex> lock(model_lock());
    return slot >= 0 && slot < 4 ? cards().sim[slot] : -1;
}

int FactoryModel::sd_present(int slot) {
    std::lock_guard<std::mutex> lock(model_lock());
    return slot == 0 ? cards().sd : -1;
}

int FactoryModel::sd_size(int slot) {
    std::lock_guard<std::mutex> lock(model_lock());
    if (slot != 0) return -1;
    return cards().sd ? static_cast<int>(cards().sdSizeMb) : 0;
}

// ---- control words ----
namespace {

int w_card(const Args &a, Reply &r) {
    long slot, present, size = 0;
    if (a.size() < 4 || a.size() > 5 || !to_int(a[2], &slot) || !to_int(a[3], &present)) return 1;
    if (a.size() == 5 && (a[1] != "sd" || !to_int(a[4], &size) || size < 1 || size > 16777216))
        return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    if (a[1] == "sim" && slot >= 0 && slot < 4) {
        cards().sim[slot] = present != 0;
    } else if (a[1] == "sd" && slot == 0) {
        cards().sd = present != 0;
        if (size > 0) cards().sdSizeMb = size;
    } else {
        return 1;
    }
    return r.done("card %s %ld %ld\n", a[1].c_str(), slot, present);
}

int w_otg(const Args &a, Reply &r) {
    if (a.size() != 2 || (a[1] != "plug" && a[1] != "unplug")) return 1;
    const bool plug = a[1] == "plug";
    {
        std::lock_guard<std::mutex> lock(model_lock());
        cards().otg = plug;
    }
    if (!plug) return r.done("otg unplugged\n");
    return send_to(kOtgStart, FTX_DATATYPE_OTG, "result=pass", r);
}

int w_nfc(const Args &a, Reply &r) {
    if (a.size() != 3 || a[1] != "tag" || !uid_ok(a[2])) return 1;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        cards().nfcUid = a[2];
    }
    return send_to(kNfcStart, FTX_DATATYPE_NFC, "result=pass;uid=" + a[2], r);
}

int w_finger(const Args &a, Reply &r) {
    if (a.size() != 2 || (a[1] != "press" && a[1] != "bad")) return 1;
    const bool good = a[1] == "press";
    {
        std::lock_guard<std::mutex> lock(model_lock());
        cards().finger = good ? "good" : "bad";
    }
    return send_to(kFingerStart, FTX_DATATYPE_FINGERPRINT, good ? "result=pass" : "result=fail", r);
}

}  // namespace

constinit const Area kCardsArea = {
    .words = {{"card", "sim SLOT 0|1 | sd 0 0|1 [SIZE_MB]", w_card},
              {"otg", "plug|unplug", w_otg},
              {"nfc", "tag UID (hex digits, ':' or '-', at most 32)", w_nfc},
              {"finger", "press|bad", w_finger}},
    .reply = reply,
    .state = state,
};

}  // namespace ftxsim
