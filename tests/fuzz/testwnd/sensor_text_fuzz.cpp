// The factory library's sensor reports: the reader stays inside the text it was given (the
// buffer here has no terminator), keeps at most its fields and values, and every line judge
// fed the result keeps its state within bounds.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include <vector>

#include "testwnd/sensors/mmi_sensor_lines.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::vector<char> text(data, data + size);  // not terminated: the reader must not need it
    mmi_sensor_report r;
    const int n = mmi_sensor_parse(text.data(), text.size(), &r);
    if (n != r.count || n < 0 || n > MMI_SENSOR_FIELDS_MAX) __builtin_trap();
    for (int i = 0; i < n; i++) {
        const mmi_sensor_field &f = r.f[i];
        if (f.count < 0 || f.count > MMI_SENSOR_VALUES_MAX) __builtin_trap();
        if (strnlen(f.key, sizeof(f.key)) == sizeof(f.key) || f.key[0] == 0) __builtin_trap();
    }
    static const mmi_sensor_kind kKinds[] = {MMI_SENSOR_AXIS_G, MMI_SENSOR_RANGE,
                                             MMI_SENSOR_ABOVE,  MMI_SENSOR_BOTH_SIDES,
                                             MMI_SENSOR_RESULT, MMI_SENSOR_COME_GO};
    for (mmi_sensor_kind kind : kKinds) {
        const mmi_sensor_line_spec spec = {
            .key = "acc", .kind = kind, .unit = "u", .decimals = 2, .extraKey = "value"};
        mmi_sensor_line l;
        mmi_sensor_line_reset(&l, &spec, 1, 2);
        const int done = mmi_sensor_line_update(&l, &r);
        if (done != 0 && done != 1) __builtin_trap();
        char value[64];
        mmi_sensor_line_value(&l, value, sizeof(value));
        if (strnlen(value, sizeof(value)) == sizeof(value)) __builtin_trap();
    }
    return 0;
}
