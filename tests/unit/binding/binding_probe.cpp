// Runs binders in a fresh process (a process binds once) and prints what happened:
// "RET <step> <result>", every log entry as "LOG <P> <TAG>: <message>", then every bound
// operation as "BOUND <name>" or "FALLBACK <name>". Steps are given as arguments.
#include <stdio.h>
#include <string.h>

#include "adbd_connection/AtThread.h"
#include "ftx_host.h"
#include "core/ftx_lib_binding.h"
#include "mmi_startup.h"
#include "session/mmi_testinfo.h"

namespace {

void print_log(int prio, const char *tag, const char *msg, void *) {
    static const char kPrio[] = "??VDIWEFS";
    printf("LOG %c %s: %s\n", prio >= 0 && prio < 9 ? kPrio[prio] : '?', tag, msg);
}

int write_item0(void) {
    mmi_write_testinfo_single_byte(0, 1);
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {};
    hw::ftx_api_GetTestInfoFlag(flags);
    printf("BYTE0 %d\n", flags[0]);
    return 0;
}

int preset_camera_id(void) {
    hw::ftx_api_cameraID_test = [](int) { return 42; };
    return 0;
}

int camera_id(void) {
    printf("CAMID %d\n", hw::ftx_api_cameraID_test(2));
    return 0;
}

const struct {
    const char *name;
    int (*run)(void);
} kSteps[] = {
    {"factory", ftx_init_lib_factory_dll},
    {"core", ftx_init_libdvk_ncoredevice_dll},
    {"channel", Get_libcoredevice_Interface},
    {"atthread", AtThreadStart},
    {"flashlight", Init_lib_Flashlight_Interface},
    {"alllight", Init_lib_Alllight_Interface},
    {"aging", Init_lib_AgingTest_Interface},
    {"pcba", Init_lib_Interface_all},
    {"preset_camid", preset_camera_id},
    {"camid", camera_id},
    {"write0", write_item0},
};

}  // namespace

int main(int argc, char **argv) {
    setvbuf(stdout, nullptr, _IOLBF, 0);
    mmi_startup_wire();  // as the program does before binding
    ftx_log_set_capture(print_log, nullptr);
    for (int i = 1; i < argc; i++) {
        bool known = false;
        for (const auto &s : kSteps) {
            if (strcmp(s.name, argv[i]) != 0) continue;
            printf("RET %s %d\n", s.name, s.run());
            known = true;
        }
        if (!known) {
            fprintf(stderr, "unknown step %s\n", argv[i]);
            return 2;
        }
    }
    ftx_log_set_capture(nullptr, nullptr);
    for (const ftx_hw_op_entry *e = g_ftx_hw_ops; e->name != nullptr; e++) {
        void *p = e->slot->get();
        if (p == nullptr) continue;
        bool fallback = p == reinterpret_cast<void *>(&func_temp) ||
                        p == reinterpret_cast<void *>(&mmi_ReadFuncTestInfoFlags) ||
                        p == reinterpret_cast<void *>(&mmi_WriteFuncTestInfoFlags);
        printf("%s %s\n", fallback ? "FALLBACK" : "BOUND", e->name);
    }
    return 0;
}
