// Handlers of the PC commands (signature AtCmdFun; bit 0 of the answer is success).
#pragma once

#include "adbd_connection/CmdParse.h"

// Result record: "<item>,read" or "<item>,<result>,write".
int AutoTest_testinfo(const char *parm, int parmLen, char *reply, unsigned int replySize);

// Core-device library operations: the file operations always answer success (their text
// says how it went); the Wi-Fi-to-PC link switch answers what the library answers.
int AutoTest_FileOpt_Read(const char *parm, int parmLen, char *reply, unsigned int replySize);
int AutoTest_FileOpt_Write(const char *parm, int parmLen, char *reply, unsigned int replySize);
int AutoTest_FileOpt_Remove(const char *parm, int parmLen, char *reply, unsigned int replySize);
int AutoTest_WiFiConCpt_Enable(const char *parm, int parmLen, char *reply, unsigned int replySize);
int AutoTest_WiFiConCpt_Disable(const char *parm, int parmLen, char *reply, unsigned int replySize);

// Shell commands: answer success whatever the command did.
int AutoTest_LCD_Turnoff(const char *parm, int parmLen, char *reply, unsigned int replySize);
int AutoTest_CABC_Open(const char *parm, int parmLen, char *reply, unsigned int replySize);
int AutoTest_CABC_Close(const char *parm, int parmLen, char *reply, unsigned int replySize);
int WiFiDataRate_set(const char *parm, int parmLen, char *reply, unsigned int replySize);

int AutoTest_EnterLowCostMode(const char *parm, int parmLen, char *reply, unsigned int replySize);
