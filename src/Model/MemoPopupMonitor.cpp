// The tracker of the last popup: a weak pointer answers whether it still lives.
#include "Model/MemoPopupMonitor.h"

#include "MemoLog.h"

using app_assist::WViewController;

MemoPopupMonitor *MemoPopupMonitor::__instance = nullptr;

MemoPopupMonitor::MemoPopupMonitor() : __popup(nullptr) {}

MemoPopupMonitor::~MemoPopupMonitor() {}

MemoPopupMonitor *MemoPopupMonitor::getInstance()
{
	if (!__instance)
		__instance = new MemoPopupMonitor();
	return __instance;
}

void MemoPopupMonitor::destroy()
{
	delete __instance;
	__instance = nullptr;
}

void MemoPopupMonitor::addPopup(WViewController *popup)
{
	if (!popup) {
		MEMO_LOGE("Input is null");
		return;
	}
	__popupWeakPtr = popup->getWeakPtr();
	__popup = popup;
}

bool MemoPopupMonitor::isPopupAlive()
{
	// An empty weak pointer (nothing tracked yet) locks to null as well.
	std::shared_ptr<WViewController> locked = __popupWeakPtr.lock();
	return locked.get() != nullptr;
}

WViewController *MemoPopupMonitor::getPopup()
{
	return isPopupAlive() ? __popup : nullptr;
}
