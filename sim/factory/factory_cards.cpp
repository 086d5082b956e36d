// Card area of the factory model: the SIM and SD cards in their slots, and storage plugged
// in over USB OTG.
#include <mutex>
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

struct Cards {
    int sim[4] = {1, 1, 0, 0};
    int sd = 1;
};

Cards &cards() {
    return model_part<Cards>();
}

// This area's part of "hw status".
void state(Reply &r) {
    const Cards &s = cards();
    r.add(" sim=%d,%d,%d,%d sd=%d", s.sim[0], s.sim[1], s.sim[2], s.sim[3], s.sd);
}

Event reply(const std::string &op) {
    if (op == "ftx_api_USB_OTG_Test_START") return {FTX_DATATYPE_OTG, "result=pass"};
    return no_event();
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

// ---- control words ----
namespace {

int w_card(const Args &a, Reply &r) {
    long slot, present;
    if (a.size() != 4 || !to_int(a[2], &slot) || !to_int(a[3], &present)) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    if (a[1] == "sim" && slot >= 0 && slot < 4) {
        cards().sim[slot] = present != 0;
    } else if (a[1] == "sd" && slot == 0) {
        cards().sd = present != 0;
    } else {
        return 1;
    }
    return r.done("card %s %ld %ld\n", a[1].c_str(), slot, present);
}

}  // namespace

constinit const Area kCardsArea = {
    .words = {{"card", "sim SLOT 0|1 | sd 0 0|1", w_card}},
    .reply = reply,
    .state = state,
};

}  // namespace ftxsim
