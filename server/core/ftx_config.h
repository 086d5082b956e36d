// Reader of the sectioned configuration files (/etc/ftx_config.ini, /etc/ftx_language.ini)
// and of parameter strings ("key:value;key:value"). The matching quirks (prefix matches,
// first match wins, the last character of a found value dropped) are how the shipped files
// are written: keep them.
#pragma once

#include <stddef.h>
#include <stdio.h>

#define FTX_MAIN_CONFIG_FILE "/etc/ftx_config.ini"
#define FTX_LANGUAGE_FILE "/etc/ftx_language.ini"

#define FTX_CFG_LINE_SIZE 2048
#define FTX_CFG_TEXT_SIZE 256
#define FTX_LANG_LIST_SIZE 2000

// One pair of a parameter string. Callers own arrays of these and zero them first.
typedef struct {
    char key[FTX_CFG_TEXT_SIZE];
    char value[FTX_CFG_TEXT_SIZE];
} ftx_config_para;

// One text of the loaded language section.
typedef struct {
    char key[FTX_CFG_TEXT_SIZE];
    char text[FTX_CFG_TEXT_SIZE];
} ftx_lang_record;

// Looks key up in domain of the file at the device path `path`. `out` holds a string
// (zeroed or a previous value); def may be null. 0 when the file was read to a match or
// to its end, -1 on a null argument, an unopenable file or a malformed domain header.
int Get_CfgValue(const char *path, const char *domain, const char *key, char *out, const char *def);
// Get_CfgValue on /etc/ftx_config.ini.
int Read_MainCfgFile(const char *domain, const char *key, char *out, const char *def);

// The domain name of a header line into a 256-byte buffer; 0 or -1.
int mmi_parse_domain(const char *line, char *name_out);
// Splits an entry line at its first '=' into two 256-byte buffers (untouched when the
// line has no usable '=').
void mmi_parse_equal(const char *line, char *key_out, char *value_out);

// Loads the section `language` of /etc/ftx_language.ini into the language list (once, at
// start-up). 0, or -1 when the file cannot be opened or a header is malformed.
int Get_CfgValueList(const char *language);
// Copies the text of text_key to out; -1 leaves out as the caller prefilled it.
int Read_LangCfgFromList(const char *text_key, char *out);

// Fills up to max records from a parameter string held in a zero-filled buffer; returns
// the number of records filled.
int ftx_config_parse_parameter(const char *str, ftx_config_para *records, int max);
// Copies the value of the first record whose key begins with name; def applies when out
// stays empty. Returns strlen(out).
int ftx_config_get_para_value(const ftx_config_para *records, int count, const char *name,
                              char *out, size_t out_size, const char *def);

// The same lookups on an open stream (the fuzz targets and tests feed memory streams).
int ftx_config_lookup_stream(FILE *fp, const char *domain, const char *key, char *out,
                             const char *def);
int ftx_config_load_lang_stream(FILE *fp, const char *language);
// Number of filled records of the language list.
int ftx_config_lang_count(void);
