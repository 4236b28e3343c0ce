// The window's title, which the window manager shows: the window's name until the app sets its own.
#include <clocale>
#include <cstdlib>
#include <libintl.h>
#include <string>

#include "TestEnv.h"
#include "support/AppAssistFixture.h"

namespace
{

using WindowTitleTest = aa_test::UiTest;

TEST_F(WindowTitleTest, TranslatedTitleFollowsTheLanguage)
{
	Evas_Object *win = window->getEvasObj();
	EXPECT_STREQ("app-assist-test", elm_win_title_get(win));

	std::string locale = memo_test::makeTempDir("locale");
	std::string de = locale + "/de/LC_MESSAGES";
	const char *po = "printf 'msgid \"IDS_T\"\\nmsgstr \"Notiz\"\\n'";
	ASSERT_EQ(0, memo_test::runCommand("mkdir -p " + de + " && " + po + " | msgfmt -o " + de + "/wtitle.mo -"));
	bindtextdomain("wtitle", locale.c_str());
	setlocale(LC_ALL, "C.UTF-8");
	setenv("LANGUAGE", "en", 1);
	window->setTitle("IDS_T", "wtitle");
	EXPECT_STREQ("IDS_T", elm_win_title_get(win)) << "no English catalogue: the id itself";

	setenv("LANGUAGE", "de", 1);
	elm_language_set("de_DE.UTF-8");
	EXPECT_STREQ("Notiz", elm_win_title_get(win));
	unsetenv("LANGUAGE");
	setlocale(LC_ALL, "C");
}

} // namespace
