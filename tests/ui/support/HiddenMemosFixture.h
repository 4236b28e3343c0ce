#ifndef TESTS_UI_SUPPORT_HIDDENMEMOSFIXTURE_H
#define TESTS_UI_SUPPORT_HIDDENMEMOSFIXTURE_H

// The app on the buffer engine with its hidden memos: PIN keys as the raw key events the PIN view takes, the
// more menu, the stored PIN beside a SHA-256 of the test's own, and a restart of the app.

#include <Ecore_Input.h>
#include <openssl/evp.h>
#include <vconf.h>

#include <cstring>
#include <vector>

#include <WMenuPopupController.h>
#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoListFixture.h"
#include "TestEnv.h"
#include "Util/MemoUtil.h"
#include "View/MemoHiddenPasswordView.h"
#include "View/MemoHiddenPinLock.h"

namespace memo_ui_test
{

class HiddenMemosFixture : public ListViewFixture
{
protected:
	void SetUp() override
	{
		ListViewFixture::SetUp();
		MemoHiddenPinLock::setClock(nullptr);
		MemoHiddenPinLock::clear();
	}
	void TearDown() override
	{
		MemoHiddenPinLock::setClock(nullptr);
		MemoHiddenPinLock::clear();
		ListViewFixture::TearDown();
	}

	template <class View> View *top()
	{
		return app ? dynamic_cast<View *>(naviframe()->getTopContentViewController()) : nullptr;
	}
	template <class View> View *waitTop()
	{
		waitFor([this] { return top<View>() != nullptr; }, 5.0);
		runFor(0.3);
		return top<View>();
	}

	// One key as the window system delivers it: an Ecore key-down event named `name`.
	void pinKey(const char *name)
	{
		struct KeyEvent {
			Ecore_Event_Key event;
			char name[32];
		};
		KeyEvent *key = new KeyEvent();
		strncpy(key->name, name, sizeof(key->name) - 1);
		key->event.keyname = key->event.key = key->name;
		key->event.string = key->event.compose = strlen(name) == 1 ? key->name : nullptr;
		key->event.timestamp = ++__keyTime;
		ecore_event_add(
		    ECORE_EVENT_KEY_DOWN, &key->event, [](void *, void *event) { delete static_cast<KeyEvent *>(event); },
		    nullptr);
		runFor(0.02);
	}
	// Each character as the key of that name; then the 0.5 s pause of the view passes.
	void typePin(const char *pin)
	{
		for (const char *c = pin; *c; c++) {
			const char name[2] = {*c, '\0'};
			pinKey(name);
		}
		runFor(0.6);
	}

	std::string barText()
	{
		MemoHiddenPasswordView *view = top<MemoHiddenPasswordView>();
		const char *text = view ? elm_object_part_text_get(view->getEvasObj(), "pin.bar.text") : nullptr;
		return text ? text : "";
	}
	std::string entryTexts()
	{
		std::string texts;
		for (const char *part : {"entry1", "entry2", "entry3", "entry4"})
			texts += std::string(texts.empty() ? "" : "|") +
			         elm_object_text_get(elm_object_part_content_get(pinLayout(), part)) + " ";
		return texts;
	}
	Evas_Object *pinLayout()
	{
		MemoHiddenPasswordView *view = top<MemoHiddenPasswordView>();
		return view ? view->getEvasObj() : nullptr;
	}
	bool forgottenPinShown()
	{
		const char *state = edje_object_part_state_get(elm_layout_edje_get(pinLayout()), "bottom.clip", nullptr);
		return state && !strcmp(state, "shown");
	}
	void signIn() { vconf_set_str("db/desktop/account/list", "com.veltron.veltronaccount|alice|alice@example.com"); }

	// The stored PIN in hexadecimal, and what it should be: SHA-256 of the PIN up to the digest's first zero byte.
	std::string storedPin()
	{
		return memo_test::queryFirst(std::string(MemoUtil::getDataPath()) + "memo.db",
		                             "SELECT hex(hiddenPass) FROM password");
	}
	static std::string digestOf(const char *pin)
	{
		unsigned char digest[EVP_MAX_MD_SIZE];
		unsigned int size = 0;
		EVP_Digest(pin, strlen(pin), digest, &size, EVP_sha256(), nullptr);
		std::string hex;
		for (unsigned int i = 0; i < size && digest[i]; i++) {
			char byte[3];
			snprintf(byte, sizeof(byte), "%02X", digest[i]);
			hex += byte;
		}
		return hex;
	}
	static void storePin(const char *pin)
	{
		char digest[MemoHiddenPasswordView::PIN_DIGEST_BUFFER_SIZE];
		MemoHiddenPasswordView::hashPin(pin, digest);
		MemoDbMgr::getInstance()->setHiddenMemoPassword(digest);
	}

	std::vector<std::string> openMenu() { return openMenuOf(naviframe()); }
	void chooseMenu(const std::string &text) { chooseMenuOf(naviframe(), text); }

	// The app ends as the platform ends it and starts again on the same store and preferences.
	void restartApp()
	{
		evas_sync(evas());
		app->onTerminate();
		delete app;
		app = nullptr;
		startApp();
	}

private:
	unsigned int __keyTime = 1000;
};

} // namespace memo_ui_test

#endif
