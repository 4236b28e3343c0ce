// The PIN's four-key steps: create (typed twice), enter, change; the stored digest, the unlock, the reset into a
// new PIN and the lock-out after wrong PINs.
#include "View/MemoHiddenPasswordView.h"

// The digest comes from the SHA-256 calls that the stored PINs have always been made with.
#define OPENSSL_SUPPRESS_DEPRECATED
#include <openssl/sha.h>

#include <cstdio>
#include <cstring>

#include <app_i18n.h>

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "View/MemoHiddenPinLock.h"
#include "View/MemoHiddenRoutes.h"
#include "View/MemoHiddenView.h"
#include "View/MemoListView.h"

using app_assist::WUiTimer;

namespace
{
// Between the fourth key and the next text on the bar, so that the fourth "*" is seen.
const double PAUSE_SEC = 0.5;
// The wait on the bar is told in minutes from this many seconds on.
const int LOCK_MINUTES_FROM_SEC = 120;
} // namespace

void MemoHiddenPasswordView::hashPin(const char *pin, char *buffer)
{
	memset(buffer, 0, PIN_DIGEST_BUFFER_SIZE);
	SHA256_CTX context;
	SHA256_Init(&context);
	SHA256_Update(&context, pin, strlen(pin));
	SHA256_Final(reinterpret_cast<unsigned char *>(buffer), &context);
}

bool MemoHiddenPasswordView::__compareEnteredPassword(const char *pin)
{
	char entered[PIN_DIGEST_BUFFER_SIZE];
	char stored[PIN_DIGEST_BUFFER_SIZE] = {};
	hashPin(pin, entered);
	MemoDbMgr::getInstance()->getHiddenMemoPassword(stored);
	if (strcmp(entered, stored) != 0) {
		MEMO_LOGE("Password does not match");
		return false;
	}
	return true;
}

void MemoHiddenPasswordView::__onFourthKey()
{
	__firstPin[PIN_LENGTH] = '\0';
	__index = 0;
	if (!__isCreateMode) {
		if (!__compareEnteredPassword(__firstPin)) {
			__onWrongPin();
			return;
		}
		MemoHiddenPinLock::clear();
		if (__isChangePin)
			resetPINView();
		else
			__unlock();
		return;
	}
	if (__isFirstEntry) {
		__isFirstEntry = false;
		__afterPause("IDS_MEMO_HEADER_CONFIRM_PIN");
		return;
	}
	// A different confirmation keeps the first PIN: the next four keys confirm again.
	if (strcmp(__firstPin, __secondPin) != 0) {
		__afterPause("IDS_MEMO_HEADER_INCORRECT_PIN_ENTERED_ABB2");
		return;
	}
	if (__storePin())
		__unlock();
}

void MemoHiddenPasswordView::__onWrongPin()
{
	MemoHiddenPinLock::addWrongPin();
	const bool withAccount = checkAccount();
	__pauseTimer = WUiTimer::addTimer(
	    PAUSE_SEC,
	    [this, withAccount](void *) {
		    __setBarText("IDS_MEMO_HEADER_INCORRECT_PIN_ENTERED_ABB2");
		    __clearEntries();
		    __showLock();
		    if (withAccount)
			    elm_object_signal_emit(__layout, "show,button", "");
		    return false;
	    },
	    nullptr, __layout);
}

bool MemoHiddenPasswordView::__storePin()
{
	char digest[PIN_DIGEST_BUFFER_SIZE];
	hashPin(__firstPin, digest);
	MemoDbMgr *db = MemoDbMgr::getInstance();
	if (!db->setHiddenMemoPassword(digest))
		return false;
	// A digest that starts with a zero byte stores as no PIN at all: the view stays for another one.
	char stored[PIN_DIGEST_BUFFER_SIZE] = {};
	if (!db->getHiddenMemoPassword(stored))
		return false;
	MemoHiddenPinLock::clear();
	return true;
}

void MemoHiddenPasswordView::__afterPause(const char *textId)
{
	WUiTimer::deleteTimer(__pauseTimer);
	__pauseTimer = WUiTimer::addTimer(
	    PAUSE_SEC,
	    [this, textId](void *) {
		    __setBarText(textId);
		    if (__isResetting) {
			    __isChangePin = false;
			    __isResetting = false;
			    __isFirstEntry = true;
			    __isCreateMode = true;
			    __setBarText("IDS_MEMO_HEADER_CREATE_PIN");
		    }
		    __clearEntries();
		    return false;
	    },
	    nullptr, __layout);
}

void MemoHiddenPasswordView::resetPINView()
{
	__setBarText("IDS_MEMO_HEADER_CREATE_PIN");
	__isResetting = true;
	WUiTimer::deleteTimer(__lockTimer);
	__afterPause("IDS_MEMO_HEADER_CONFIRM_PIN");
}

bool MemoHiddenPasswordView::__showLock()
{
	const int seconds = MemoHiddenPinLock::getRemainingSeconds();
	if (seconds <= 0)
		return false;
	char text[128];
	if (seconds >= LOCK_MINUTES_FROM_SEC)
		snprintf(text, sizeof(text), i18n_get_text("IDS_MEMO_HEADER_TRY_AGAIN_IN_PD_MINUTES"), (seconds + 59) / 60);
	else
		snprintf(text, sizeof(text), i18n_get_text("IDS_MEMO_HEADER_TRY_AGAIN_IN_PD_SECONDS"), seconds);
	elm_object_part_text_set(__layout, "pin.bar.text", text);
	MEMO_LOGI("PIN tries locked for %d more seconds", seconds);
	if (__lockTimer.expired()) {
		// Keeps the wait told, and gives the bar back when the lock ends.
		__lockTimer = WUiTimer::addTimer(
		    1.0,
		    [this](void *) {
			    if (__isCreateMode)
				    return false;
			    if (MemoHiddenPinLock::getRemainingSeconds() > 0) {
				    __showLock();
				    return true;
			    }
			    __setBarText("IDS_MEMO_HEADER_ENTER_PIN");
			    return false;
		    },
		    nullptr, __layout);
	}
	return true;
}

void MemoHiddenPasswordView::__unlock()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe) {
		MEMO_LOGE("Naviframe is NULL");
		return;
	}
	MemoListView *parent = __parent;
	const bool toHiddenMemos = !__isFromSettings && MemoDbMgr::getInstance()->getHiddenMemoCount() > 0;
	if (__isTop())
		popOut();
	if (parent) {
		parent->__hideFloatingButton();
		parent->__isTopView = false;
	}
	if (toHiddenMemos)
		naviframe->push(new MemoHiddenView(parent));
	else
		memoHiddenPushListPage(naviframe, MemoHiddenListPage::SELECTION, 1);
}
