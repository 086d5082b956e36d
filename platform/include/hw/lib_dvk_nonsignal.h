/* The handset's non-signalling RF library, lib_dvk_nonsignal.so: the modem's RF test mode,
 * reached through its diagnostic interface, for a non-signalling tester at the RF station
 * (no call is set up: the handset is told its technology, band and channel, transmits at a
 * given power that the tester measures, and reports the level of the tester's downlink).
 *
 * Powers and levels are in tenths of a dBm: 230 is 23.0 dBm, -605 is -60.5 dBm.
 * Every operation answers 0 on success. Outside the test mode every setting fails; the
 * transmitter needs a technology, a band and a channel first. */
#ifndef FTX_HW_LIB_DVK_NONSIGNAL_H
#define FTX_HW_LIB_DVK_NONSIGNAL_H

#ifdef __cplusplus
extern "C" {
#endif

/* Technologies of FTX_API_NonSignal_setTech. */
#define FTX_RF_TECH_LTE 1
#define FTX_RF_TECH_GSM 2
#define FTX_RF_TECH_CDMA2000 3
#define FTX_RF_TECH_WCDMA 4
#define FTX_RF_TECH_TDSCDMA 5

/* Enters and leaves the test mode; leaving it also switches the transmitter off. */
int FTX_API_NonSignal_open(void);
int FTX_API_NonSignal_close(void);
/* The technology, then its band (the technology's band number: LTE 1..., GSM 900 or 1800,
 * CDMA2000 band class, WCDMA 1..., TD-SCDMA 34, 39, ...) and channel (EARFCN, ARFCN,
 * CDMA channel, UARFCN). A new technology or band clears what came after it. */
int FTX_API_NonSignal_setTech(int tech);
int FTX_API_NonSignal_setBand(int band);
int FTX_API_NonSignal_setChannel(int channel);
/* The transmitter on at power (tenths of a dBm), and off. */
int FTX_API_NonSignal_txOn(int power);
int FTX_API_NonSignal_txOff(void);
/* The received level of the tester's downlink on the channel set, tenths of a dBm. */
int FTX_API_NonSignal_getRxLevel(int *level);

#ifdef __cplusplus
}
#endif
#endif
