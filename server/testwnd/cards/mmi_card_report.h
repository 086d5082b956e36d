// The factory library's reports of the peripheral tests (USB OTG, NFC, fingerprint):
// "result=pass" or "result=fail", the NFC reader adding the tag's identifier
// ("result=pass;uid=04A2B3C4").
#pragma once

#include <stddef.h>

#define MMI_CARD_UID_SIZE 33  // at most 32 characters and the terminator

enum mmi_card_result { MMI_CARD_NONE = 0, MMI_CARD_PASS = 1, MMI_CARD_FAIL = 2 };

struct mmi_card_report {
    int result = MMI_CARD_NONE;        // a report without a known result field says nothing
    char uid[MMI_CARD_UID_SIZE] = {};  // "" when the report names none
};

// Reads the first len bytes of text (no terminator needed; a 0 byte ends it early) into out:
// fields split at ';', each "key=value", unknown keys left out. A uid keeps its printable
// characters (no blank), cut at 32. Returns out->result.
int mmi_card_parse_report(const char *text, size_t len, mmi_card_report *out);
