// The aging settings of the main configuration's FTX_AGING domain. Each key holds a
// parameter list; a parameter missing from a present key takes its in-key default, a
// missing key takes its no-key value, and the two differ in places.
#pragma once

// Factory result server the aging records go to when a site configures none.
#define MMI_AGING_DEFAULT_ENDPOINT "192.168.10.1:8866"
#define MMI_AGING_ENDPOINT_SIZE 128
#define MMI_AGING_SSID_SIZE 64

extern int g_bAging_VedioTest;
extern int g_iAgingVedioTestTime;  // minutes
extern int g_bAging_LightTest;
extern int g_iAgingLightTime;  // minutes
extern int g_bAging_CameraTest;
extern int g_iAgingCameraTotalNum;  // camera checks per cycle
extern int g_iCameraTotalNum;       // cameras checked (ids 0 .. n-1)
extern int g_bAging_RebootTest;
extern int g_iAgingTotalRebootNum;  // reboots per cycle
extern int g_bAging_SuspendTest;
extern int g_iAgingSuspendTotalNum;  // standby cycles per cycle
extern int g_bAging_VibratorTest;
extern int g_iAgingVibratorTime;  // minutes
extern int g_bAging_AudioLoop;
extern int g_iAgingCycles;
extern int g_iAgingTempUpLimit;   // battery temperature (tenths of a degree) that pauses
extern int g_iAgingTempUncharge;  // below it charging and the run go on
extern int g_bAging_CpuFullLoad;
extern int g_cputime;  // minutes
extern int g_bAging_SaveDb;
extern int g_iAgingSaveDbTime;  // minutes between uploads while running, 0: at the end only
extern char g_chAgingSaveDbSsid[MMI_AGING_SSID_SIZE];
extern int g_bAging_ExternalBattery;
extern char g_iport[MMI_AGING_ENDPOINT_SIZE];  // "address:port" of the result server

// Reads the settings above from the configuration, logging each group.
void mmi_AgingTest_ReadConfig(void);
// The built-in values (before any read; tests).
void mmi_aging_config_reset(void);
