#ifndef VIEW_MEMOSTORAGEFULL_H
#define VIEW_MEMOSTORAGEFULL_H

#include <functional>

#include <WPopupController.h>

// What the list and the editor show when storage is below the limit for a new memo: a toast in power
// saving mode (null result), else the popup whose Settings button opens the storage settings. The caller
// attaches the popup and registers it with the popup monitor.
app_assist::WPopupController *memoStorageFullPopupN(const std::function<void()> &onCancel);

// Storage settings at their details page; each failed step is logged and the next one tried.
void memoLaunchStorageSettings();

#endif
