// Start-up wiring: what the lower layers call upward is handed to them here, once, before
// anything runs.
#pragma once

// Hands in the catalogue and the list builder, the binding's stand-bys, the receivers of
// the runs and the device-test list the sequence opens.
void mmi_startup_wire(void);
// Points power management at the bound library operations and the title strip.
void mmi_power_use_bound_library(void);
