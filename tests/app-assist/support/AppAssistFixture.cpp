// Shared UI scaffolding of the framework tests.
#include "AppAssistFixture.h"

#include "TestEnv.h"

#include <algorithm>

namespace aa_test
{

static void initElementaryOnce()
{
	static bool ready = false;
	if (ready)
		return;
	static char arg0[] = "app-assist-test";
	static char *argv[] = {arg0, nullptr};
	elm_init(1, argv);
	ready = true;
}

void UiTest::SetUp()
{
	initElementaryOnce();
	window = new app_assist::WWindowController("app-assist-test", ELM_WIN_BASIC);
	ASSERT_NE(window->getEvasObj(), nullptr);
	naviframe = new app_assist::WNaviframeController();
	ASSERT_TRUE(window->attachBaseViewController(naviframe));
	runFor(0.05);
}

void UiTest::TearDown()
{
	delete window;
	window = nullptr;
	naviframe = nullptr;
	runFor(0.02);
}

void UiTest::pressKey(const char *keyName)
{
	Evas *evas = evas_object_evas_get(window->getEvasObj());
	evas_event_feed_key_down(evas, keyName, keyName, nullptr, nullptr, 0, nullptr);
	evas_event_feed_key_up(evas, keyName, keyName, nullptr, nullptr, 0, nullptr);
	runFor(0.05);
}

namespace
{
struct LoopWait {
	const std::function<bool()> *pred;
	double end;
};
} // namespace

static Eina_Bool checkLoopWaitCb(void *data)
{
	LoopWait *wait = static_cast<LoopWait *>(data);
	if ((*wait->pred)() || ecore_time_get() > wait->end) {
		ecore_main_loop_quit();
		return ECORE_CALLBACK_CANCEL;
	}
	return ECORE_CALLBACK_RENEW;
}

bool UiTest::waitFor(const std::function<bool()> &pred)
{
	if (pred())
		return true;
	LoopWait wait = {&pred, ecore_time_get() + 3.0};
	ecore_timer_add(0.005, checkLoopWaitCb, &wait);
	ecore_main_loop_begin();
	return pred();
}

void UiTest::runFor(double seconds)
{
	double end = ecore_time_get() + seconds;
	waitFor([end] { return ecore_time_get() > end; });
}

LoggingPage *UiTest::pushPage(const char *tag)
{
	LoggingPage *page = new LoggingPage(tag, &log);
	EXPECT_TRUE(naviframe->push(page));
	return page;
}

std::vector<std::string> UiTest::entriesOf(const std::string &tag) const
{
	std::vector<std::string> out;
	for (const std::string &line : log)
		if (line.compare(0, tag.size() + 1, tag + ":") == 0)
			out.push_back(line.substr(tag.size() + 1));
	return out;
}

bool UiTest::hasEntry(const std::string &line) const
{
	return std::find(log.begin(), log.end(), line) != log.end();
}

Evas_Object *LoggingPage::onCreateView(Evas_Object *parent, void *param)
{
	__note("onCreateView");
	receivedParam = param;
	if (__failCreate)
		return nullptr;
	Evas_Object *label = elm_label_add(parent);
	elm_object_text_set(label, ("Page " + __tag).c_str());
	evas_object_show(label);
	return label;
}

} // namespace aa_test
