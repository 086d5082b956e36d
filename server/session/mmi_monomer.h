// The monomer (single-unit) preview: the enabled items of its own short list, one after
// another. Nothing is recorded: the run only shows each screen in turn.
#pragma once

#include <atomic>

// 1 while the preview runs.
extern std::atomic<int> g_bMonomerPreviewRunning;

// The menu's "menu_TPPreviewTest" row: rebuilds the list and opens its first item.
int mmi_testwnd_MonomerPreview_Entry(void);  // 0, or -1 when nothing is enabled
// Called by a preview screen when it is done, with its own domain: opens the next item,
// or ends the preview after the last one. 0 when a next item was opened, 1 at the end.
int mmi_startNextMonomerPreviewItemTest(const char *domain);
// Makes the preview the receiver of what its screens report.
void mmi_monomer_install_run(void);
