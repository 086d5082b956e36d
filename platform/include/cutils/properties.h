/* Android system properties. On the host they are read from $FTX_ROOT/sim/properties
 * (name=value lines) at first use and kept in memory. */
#ifndef FTX_CUTILS_PROPERTIES_H
#define FTX_CUTILS_PROPERTIES_H

#ifdef __cplusplus
extern "C" {
#endif

#define PROPERTY_KEY_MAX 32
#define PROPERTY_VALUE_MAX 92

/* Copies the value (or default_value when unset) into value and returns its length. */
int property_get(const char *key, char *value, const char *default_value);
int property_set(const char *key, const char *value);

#ifdef __cplusplus
}
#endif
#endif
