#include "session/mmi_runstate.h"

std::atomic<int> g_bAutoTestRunning{0};
std::atomic<int> g_deviceIsAgingTest{0};

namespace {

std::atomic<const mmi_run_ops *> s_runs[MMI_RUN_KINDS];

const mmi_run_ops *receiver(int kind) {
    return kind >= 0 && kind < MMI_RUN_KINDS ? s_runs[kind].load() : nullptr;
}

}  // namespace

void mmi_run_install(int kind, const mmi_run_ops *ops) {
    if (kind >= 0 && kind < MMI_RUN_KINDS) s_runs[kind] = ops;
}

void mmi_run_pass(int kind, int resultIndex, const char *domain) {
    const mmi_run_ops *r = receiver(kind);
    if (r != nullptr && r->pass != nullptr) r->pass(resultIndex, domain);
}

void mmi_run_fail(int kind, int resultIndex) {
    const mmi_run_ops *r = receiver(kind);
    if (r != nullptr && r->fail != nullptr) r->fail(resultIndex);
}

void mmi_run_windows_closed(void) {
    for (int kind = 0; kind < MMI_RUN_KINDS; kind++) {
        const mmi_run_ops *r = receiver(kind);
        if (r != nullptr && r->windows_closed != nullptr) r->windows_closed();
    }
}
