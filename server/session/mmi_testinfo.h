// The pass/fail record: two bits an item in the factory library's 256-byte flag area,
// mirrored in g_testinfo with each item's label.
#pragma once

#include <stdint.h>

#include <atomic>

#define MMI_TESTINFO_ITEMS 400
#define MMI_TESTINFO_LABEL_SIZE 40
#define MMI_TESTINFO_FLAGS_SIZE 256

// Result values of an item.
#define MMI_RESULT_UNTESTED 0
#define MMI_RESULT_PASS 1
#define MMI_RESULT_FAIL 2

// Summary items of the CAC preview, both in byte 16.
#define MMI_ITEM_CAC_PREVIEW 64
#define MMI_ITEM_CAC_PREVIEW_TEMP 66

typedef struct {
    int32_t index;  // the item's number; three rows carry a copied one
    std::atomic<uint32_t> test_result;
    char context[MMI_TESTINFO_LABEL_SIZE];  // station key, or a Chinese label in GBK
} mmi_testinfo_t;

extern mmi_testinfo_t g_testinfo[MMI_TESTINFO_ITEMS];

// The item's two bits in a 256-byte flag buffer (0..3); sets the current byte and slot.
int GetSign(const unsigned char *flags, int item);
// Sets the two bits of slot (0..3) in *byte to value; 1, or 0 when value is above 2.
int SetSignInOneByte(unsigned char *byte, int slot, int value);
// Decodes every item of a flag buffer into g_testinfo; the current byte and slot become
// 99 and 3.
void GetTestItemsResult(const unsigned char *flags);
// The byte index and slot of the last single-item encode or decode.
void mmi_testinfo_current(int *byteIndex, int *slot);

// Records result (1 pass, 2 fail) for item through the factory library and checks it by
// reading back; a fail of a station item also fails the CAC preview. Always 0.
int mmi_write_testinfo_single_byte(int item, int result);
// Called on the writer's thread after every write above, outside its lock, so that a
// screen showing the record can redraw; null for none.
extern std::atomic<void (*)(void)> g_testinfoChanged;

// PC back ends of "testinfoMoudle testItem": "<item>,read" answers the item's value in
// reply; "<item>,<result>,write" records it. 1 on success, 0 on a malformed command.
int mmi_AutoTest_testinfo_Read(const char *command, int length, char *reply,
                               unsigned int replySize);
int mmi_AutoTest_testinfo_Write(const char *command, int length);

// spec is "name:limit"; 1 when value is strictly below (isMax bit 0 set) or strictly
// above the limit, 0 otherwise or when spec has no colon.
int CheckParaResult(const char *spec, int value, int isMax);

// Stand-ins bound when the library lacks the flag operations: nothing happens, 0.
int mmi_WriteFuncTestInfoFlags(int index, unsigned char value);
int mmi_ReadFuncTestInfoFlags(int index, unsigned char *value);
// Hands the two stand-ins to the binding (before the factory library is bound).
void mmi_testinfo_hand_binding_fallbacks(void);
