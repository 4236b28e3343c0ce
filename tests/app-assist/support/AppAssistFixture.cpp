// Shared UI scaffolding of the framework tests.
#include "AppAssistFixture.h"

#include "TestEnv.h"

#include <algorithm>

namespace aa_test
{

void UiTest::SetUp()
{
	memo_test::initElementary();
	window = new app_assist::WWindowController("app-assist-test", ELM_WIN_BASIC);
	ASSERT_NE(window->getEvasObj(), nullptr);
	naviframe = new app_assist::WNaviframeController();
	ASSERT_TRUE(window->attachBaseViewController(naviframe));
	ASSERT_TRUE(memo_test::waitForFrame(window->getEvasObj()));
}

void UiTest::TearDown()
{
	delete window;
	window = nullptr;
	naviframe = nullptr;
	memo_test::pumpFor(0.01);
}

void UiTest::pressKey(const char *keyName)
{
	Evas *evas = evas_object_evas_get(window->getEvasObj());
	evas_event_feed_key_down(evas, keyName, keyName, nullptr, nullptr, 0, nullptr);
	evas_event_feed_key_up(evas, keyName, keyName, nullptr, nullptr, 0, nullptr);
}

bool UiTest::waitFor(const std::function<bool()> &pred)
{
	return memo_test::pump(3.0, pred);
}

void UiTest::settle()
{
	bool ran = false;
	ecore_job_add([](void *data) { *static_cast<bool *>(data) = true; }, &ran);
	ASSERT_TRUE(waitFor([&] { return ran; }));
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
