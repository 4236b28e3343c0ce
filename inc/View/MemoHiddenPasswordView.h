#ifndef INC_VIEW_MEMOHIDDENPASSWORDVIEW_H
#define INC_VIEW_MEMOHIDDENPASSWORDVIEW_H

#include <Ecore.h>
#include <Elementary.h>
#include <app_control.h>

#include <WContentViewController.h>
#include <WUiTimer.h>

class MemoListView;

// The four-character PIN in front of the hidden memos: it is created (typed twice), asked for, or changed (the
// old one first). Keys are taken as raw key events, each by the first letter of its name; the four entries
// only show a "*" per key and are never read back. The PIN is stored as its SHA-256 digest. A forgotten PIN is
// cleared through the confirmation of the signed-in account; five wrong PINs in a row lock the tries for a
// while (MemoHiddenPinLock).
//
// Files: MemoHiddenPasswordView.cpp (layout, keys), MemoHiddenPasswordViewPin.cpp (the four-key steps, digest,
// unlock, reset, lock-out), MemoHiddenPasswordViewAccount.cpp (the account check and confirmation).
class MemoHiddenPasswordView : public app_assist::WContentViewController
{
public:
	// parent: the list the hidden memos are opened from, or null (a PIN change from the hidden memos).
	explicit MemoHiddenPasswordView(MemoListView *parent);
	const char *getClassName() const override;

	// Asks for the old PIN first, then a new one is created.
	void setChangePin(bool isChangePin);
	// Opened from the settings: the unlock goes to the choice of hidden memos, whatever is hidden already.
	void setFromSettings(bool isFromSettings);

	void onPushed(Elm_Object_Item *naviItem) override;
	void onBecomeTop() override;

	// Turns the view into the creation of a new PIN (after the old PIN or a confirmed account).
	void resetPINView();
	// Whether the sync account is signed in; logs what the account service answered.
	bool checkAccount();
	// Asks the account app to confirm the signed-in account; only its "succeeded" resets the PIN.
	void veltronAccountLaunch();

	// The SHA-256 digest of pin as the store keeps it: the 32 raw bytes in a zeroed buffer of
	// PIN_DIGEST_BUFFER_SIZE, read as a text, so up to its first zero byte.
	static const int PIN_DIGEST_BUFFER_SIZE = 257;
	static void hashPin(const char *pin, char *buffer);

protected:
	// The layout (group "memo.hidden.password") with its four entries, key handler and forgotten-PIN button;
	// null with "parent object is NULL".
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~MemoHiddenPasswordView() override;

private:
	static const int PIN_LENGTH = 4;

	static Eina_Bool __keyboardPressedCb(void *data, int type, void *event);
	static void __entryFocusedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __forgottenPinCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __backBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __accountReplyCb(app_control_h request, app_control_h reply, app_control_result_e result, void *data);

	Evas_Object *__createEntry(Evas_Object *layout, int number);
	void __onKey(const char *keyName);
	void __onFourthKey();
	void __onWrongPin();
	bool __compareEnteredPassword(const char *pin);
	bool __storePin();
	void __unlock();
	void __setBarText(const char *textId);
	void __clearEntries();
	void __focusEntry(int index);
	// After 0.5 s: the bar shows textId and the entries clear; then, when resetting, the creation begins.
	void __afterPause(const char *textId);
	// The lock-out: the bar tells the wait, and a tick keeps it told until the lock ends. True while locked.
	bool __showLock();
	bool __isTop();

	MemoListView *__parent;
	Evas_Object *__layout;
	Evas_Object *__entries[PIN_LENGTH];
	int __index;
	bool __isCreateMode;
	bool __isFirstEntry;
	bool __isChangePin;
	bool __isResetting;
	Elm_Entry_Filter_Limit_Size __limit;
	char __firstPin[PIN_LENGTH + 1];
	char __secondPin[PIN_LENGTH + 1];
	Ecore_Event_Handler *__keyHandler;
	bool __isFromSettings;
	// Set by no path: onBecomeTop would pop the view.
	bool __popOnBecomeTop;
	app_assist::WUiTimerHandle __pauseTimer;
	app_assist::WUiTimerHandle __lockTimer;
};

#endif
