// The application's channel as start-up brings it up: binds the simulated libraries,
// starts the command thread with AtThreadStart and serves until stdin closes.
#include <stdio.h>
#include <unistd.h>

#include "adbd_connection/AtThread.h"
#include "core/ftx_lib_binding.h"

int main() {
    if (ftx_init_lib_factory_dll() != 0 || ftx_init_libdvk_ncoredevice_dll() != 0) {
        printf("BIND FAILED\n");
        return 1;
    }
    printf("START %d\n", AtThreadStart());
    fflush(stdout);
    char c;
    while (read(0, &c, 1) > 0) {
    }
    return 0;
}
