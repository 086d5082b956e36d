// A technology's parameter string: a plan read from it is either refused with a reason or
// holds only steps, powers and limits in their ranges.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include <string>

#include "coupling/mmi_nonsignal_plan.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size == 0) return 0;
    const mmi_ns_tech &tech = kMmiNsTechs[data[0] % MMI_NS_TECHS];
    const std::string text(reinterpret_cast<const char *>(data + 1), size - 1);
    mmi_ns_plan p;
    const int rc = mmi_ns_parse_plan(tech, text.c_str(), &p);
    if (rc != 0 && rc != -1) __builtin_trap();
    if (rc == -1 && (p.valid || !p.enabled || p.reason[0] == '\0')) __builtin_trap();
    if (memchr(p.reason, '\0', sizeof p.reason) == nullptr) __builtin_trap();
    if (rc == 0 && p.enabled) {
        if (p.stepCount < 1 || p.stepCount > MMI_NS_MAX_STEPS) __builtin_trap();
        for (int i = 0; i < p.stepCount; i++)
            if (p.steps[i].band < 0 || p.steps[i].channel < 0) __builtin_trap();
        if (p.min > p.max || p.min < -2000 || p.max > 600 || p.settleMs < 0 || p.settleMs > 10000)
            __builtin_trap();
    }
    if (rc == 0 && !p.enabled && p.stepCount != 0) __builtin_trap();
    return 0;
}
