// The pieces of the configuration writer, for its tests and fuzz target.
#pragma once

#include <string>

#define MMI_CFG_NAME_SIZE 256

// Rewrites one key of the main configuration: parm is "DOMAIN,key,value". 1 on success.
int mmi_AutoTest_Modify_ConfigFile(const char *parm);
// Makes the system partition (which holds /etc) writable. 0 on success.
int remount_system_partition(void);

// Splits "DOMAIN,key,value" into three 256-byte buffers; -1 when a part is missing, too
// long, or would break the file's line structure.
int mmi_config_split_parm(const char *parm, char *domain, char *key, char *value);
// `in` with key of domain set to value: the first line of that exact domain and key is
// replaced (keeping its line end); a missing key goes at the end of its domain, a missing
// domain at the end of the file. 0, or -1 for unsafe names.
int mmi_config_set_value(const std::string &in, const char *domain, const char *key,
                         const char *value, std::string *out);
// Removes the temporary of a rewrite that a kill cut short (start-up, before any rewrite
// runs). 1 when there was one, else 0.
int mmi_config_clear_stale_temporary(void);
