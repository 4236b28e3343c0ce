// Translations follow the device language set through vconf, with catalogues compiled at test time.
#include <app_i18n.h>
#include <gtest/gtest.h>
#include <vconf.h>

#include <Ecore.h>

#include <clocale>
#include <cstdlib>
#include <string>

#include "TestEnv.h"

namespace
{
int gLanguageChanges;

// What the application layer does on a language change: LANGUAGE and the locale. The locales
// named here are not installed on the test machine, so setlocale fails, as on most desktops.
void languageChangedCb(keynode_t *node, void *)
{
	const char *lang = vconf_keynode_get_str(node);
	setenv("LANGUAGE", lang, 1);
	setlocale(LC_ALL, lang);
	++gLanguageChanges;
}

void compileCatalogue(const std::string &res, const std::string &lang, const std::string &hello)
{
	std::string dir = res + "locale/" + lang + "/LC_MESSAGES";
	ASSERT_EQ(0, memo_test::runCommand("mkdir -p '" + dir + "'"));
	std::string po = res + lang + ".po";
	ASSERT_EQ(0, memo_test::runCommand("printf 'msgid \"IDS_HELLO\"\\nmsgstr \"" + hello + "\"\\n' > '" + po +
	                                   "' && msgfmt -o '" + dir + "/com.veltron.memo.mo' '" + po + "'"));
}

class I18nLanguage : public testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		std::string res = memo_test::makeTempDir("res") + "/";
		compileCatalogue(res, "de", "Hallo");
		compileCatalogue(res, "fr", "Bonjour");
		// Before the first lookup: the domain is bound lazily.
		setenv("TIZEN_APP_RES_DIR", res.c_str(), 1);
		ecore_init(); // for the change notices
	}

	static void changeLanguage(const char *langset)
	{
		int before = gLanguageChanges;
		ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_LANGSET, langset));
		ASSERT_TRUE(memo_test::pump(5, [&] { return gLanguageChanges > before; }));
	}
};
} // namespace

TEST_F(I18nLanguage, LookupFollowsLanguageChangesWithoutInstalledLocales)
{
	ASSERT_EQ(VCONF_OK, vconf_notify_key_changed(VCONFKEY_LANGSET, languageChangedCb, nullptr));
	changeLanguage("en_US.UTF-8");
	EXPECT_STREQ("IDS_HELLO", _("IDS_HELLO")) << "no English catalogue: the id itself";

	changeLanguage("de_DE.UTF-8");
	EXPECT_STREQ("Hallo", _("IDS_HELLO"));
	changeLanguage("fr_FR.UTF-8");
	EXPECT_STREQ("Bonjour", _("IDS_HELLO"));
	changeLanguage("de_DE.UTF-8");
	EXPECT_STREQ("Hallo", i18n_get_text("IDS_HELLO"));
	EXPECT_STREQ("IDS_UNKNOWN", _("IDS_UNKNOWN"));
	EXPECT_EQ(nullptr, i18n_get_text(nullptr));

	// With a real UTF-8 locale in force the lookup keeps following LANGUAGE.
	ASSERT_NE(nullptr, setlocale(LC_ALL, "C.UTF-8"));
	setenv("LANGUAGE", "fr_FR.UTF-8", 1);
	EXPECT_STREQ("Bonjour", _("IDS_HELLO"));
	EXPECT_EQ(VCONF_OK, vconf_ignore_key_changed(VCONFKEY_LANGSET, languageChangedCb));
	setlocale(LC_ALL, "C");
}
