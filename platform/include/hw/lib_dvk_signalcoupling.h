/* The handset's signal-coupling library, lib_dvk_signalcoupling.so: modem mode control. */
#ifndef FTX_HW_LIB_DVK_SIGNALCOUPLING_H
#define FTX_HW_LIB_DVK_SIGNALCOUPLING_H

#ifdef __cplusplus
extern "C" {
#endif

/* Modem modes of FTX_API_SignalCoupling_setModemMode. */
#define FTX_MODEM_MODE_ONLINE 4
#define FTX_MODEM_MODE_LOW_POWER 5

/* 0 on success. setModemMode fails before init or after uninit. */
int FTX_API_SignalCoupling_init(void);
int FTX_API_SignalCoupling_uninit(void);
int FTX_API_SignalCoupling_setModemMode(int mode);

#ifdef __cplusplus
}
#endif
#endif
