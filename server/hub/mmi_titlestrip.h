// The hub's title strip: charger, title and battery level, and the warnings other parts set
// over the title.
#pragma once

// Sets one item of the title strip from any thread.
int TitleInfoShow(const char *text, int index, int abnormalState);
