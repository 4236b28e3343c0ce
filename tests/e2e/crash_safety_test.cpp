// The real memo app killed with SIGKILL at random moments while other programs write into it: quick memo
// appends that were answered and edits whose app ended by itself are all in the store afterwards, the
// store is whole, and no memo lost its body or files. MEMO_LONG=1 runs the full 1,000 writes.
#include <gtest/gtest.h>

#include <app_manager.h>

#include <signal.h>
#include <unistd.h>

#include <cstdio>
#include <map>
#include <random>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "support/E2e.h"

namespace
{
#ifdef __SANITIZE_ADDRESS__
const int SHORT_RUN = 40; // the sanitizer build starts the app several times slower
#else
const int SHORT_RUN = 100;
#endif
const std::string OP = "-o http://tizen.org/appcontrol/operation/";
const std::string TEXT = " -d http://tizen.org/appcontrol/data/text ";

pid_t memoPid()
{
	app_context_h context = nullptr;
	pid_t pid = -1;
	if (app_manager_get_app_context("com.veltron.memo", &context) == APP_MANAGER_ERROR_NONE)
		app_context_get_pid(context, &pid);
	app_context_destroy(context);
	return pid;
}

std::set<std::string> linesOf(const std::string &text)
{
	std::set<std::string> lines;
	std::istringstream in(text);
	for (std::string line; std::getline(in, line);)
		lines.insert(line);
	return lines;
}

// A memo's body and its files' paths, as the store has them.
std::string bodyAndFiles(const memo_test::MemoLaunch &app, const std::string &uuid)
{
	return app.query("SELECT content || '|' || tizenXmlContent || '|' || ifnull((SELECT group_concat(path, char(10)) "
	                 "FROM file WHERE memoUUID = UUID), '') FROM memo WHERE isDeleted = 0 AND UUID = '" +
	                 uuid + "'");
}
} // namespace

TEST(CrashSafety, KilledAtRandomTheStoreKeepsEveryAcknowledgedWrite)
{
	const int total = getenv("MEMO_LONG") ? 1000 : SHORT_RUN;
	const char *seedText = getenv("MEMO_CRASH_SEED"); // to replay a run
	const unsigned seed = seedText ? static_cast<unsigned>(atol(seedText)) : static_cast<unsigned>(time(nullptr));
	std::mt19937 random(seed);
	memo_test::MemoLaunch app;
	ASSERT_EQ(0,
	          memo_test::runCommand(app.env + "'" + memo_test::helperPath("memo_seed") + "' fill 12 >/dev/null 2>&1"));
	std::map<std::string, std::string> before;
	for (const std::string &uuid :
	     linesOf(app.query("SELECT group_concat(UUID, char(10)) FROM memo WHERE isQuick = 0")))
		before[uuid] = bodyAndFiles(app, uuid);
	ASSERT_EQ(12u, before.size());

	// A text far larger than anyone collects is refused, answered as failed, and changes nothing.
	std::string out;
	app.send(OP + "send_text_quickmemo -r" + TEXT + std::string(70000, 'x'), &out);
	EXPECT_NE(std::string::npos, out.find("result=failed")) << out;
	EXPECT_TRUE(app.waitForLog("quick memo text of 70000 bytes refused"));

	std::vector<std::string> appended, edited;
	int kills = 0;
	auto killSoon = [&](int maxMs) {
		usleep(std::uniform_int_distribution<int>(0, maxMs)(random) * 1000);
		const pid_t pid = memoPid();
		if (pid > 0 && kill(pid, SIGKILL) == 0)
			++kills;
		memo_test::pump(5, [] { return memoPid() < 0; });
	};
	for (int i = 0; i < total; ++i) {
		const std::string text = "write " + std::to_string(i);
		if (i % 10 == 9) {
			// An edit through the editor: a shared text opens it, the end request saves it, perhaps cut short.
			killSoon(0);
			if (app.start(OP + "share_text" + TEXT + "'" + text + "'") != "MemoEditView" ||
			    !app.waitForLog("shared text in the body"))
				continue;
			app.send("-k com.veltron.memo >/dev/null");
			if (random() % 2)
				killSoon(300);
			if (memo_test::pump(5, [] { return memoPid() < 0; }) && app.log().find("> ~MemoApp") != std::string::npos)
				edited.push_back(text);
			continue;
		}
		FILE *launcher = popen((app.env + "'" + app.launcher + "' -s com.veltron.memo " + OP +
		                        "send_text_quickmemo -r" + TEXT + "'" + text + "' 2>/dev/null")
		                           .c_str(),
		                       "r");
		ASSERT_NE(launcher, nullptr);
		if (random() % 4 == 0)
			killSoon(150);
		std::string out;
		for (char buf[256]; fgets(buf, sizeof(buf), launcher);)
			out += buf;
		if (pclose(launcher) == 0 && out.find("result=succeeded") != std::string::npos)
			appended.push_back(text);
	}
	app.end();

	EXPECT_EQ("ok", app.query("PRAGMA integrity_check"));
	const std::set<std::string> quick = linesOf(app.query("SELECT content FROM memo WHERE isQuick = 1"));
	int lost = 0;
	for (const std::string &text : appended)
		lost += !quick.count(text);
	for (const std::string &text : edited)
		lost += app.query("SELECT count(*) FROM memo WHERE content = '" + text + "'") != "1";
	printf("crash safety: writes=%d acknowledged=%zu edits=%zu kills=%d lost=%d (seed %u)\n", total,
	       appended.size() + edited.size(), edited.size(), kills, lost, seed);
	EXPECT_EQ(0, lost);
	EXPECT_GT(kills, 0);
	EXPECT_GT(appended.size(), static_cast<size_t>(total / 2));

	// The memos from before are whole: their bodies, their file rows and the files themselves.
	for (const auto &memo : before) {
		EXPECT_EQ(memo.second, bodyAndFiles(app, memo.first));
		const std::string paths = memo.second.substr(memo.second.rfind('|') + 1);
		for (const std::string &path : linesOf(paths))
			EXPECT_EQ(0, access(path.c_str(), F_OK)) << path;
	}
}
