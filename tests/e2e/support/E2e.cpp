#include "E2e.h"

#include <signal.h>

namespace memo_test
{
MemoLaunch::MemoLaunch(const std::string &env_, const std::string &root_, const std::string &launcher_)
    : root(root_.empty() ? makeTempDir("memo-launch") : root_),
      env(env_ + (root_.empty() ? " TIZEN_APP_ROOT='" + root + "' " : " ")), launcher(launcher_)
{
}

int MemoLaunch::send(const std::string &args, std::string *out) const
{
	return runCommand(env + "'" + launcher + "' -s com.veltron.memo " + args + " 2>/dev/null", out);
}

std::string MemoLaunch::start(const std::string &args, std::string *out)
{
	logStart = readFile(root + "/data/dlog.log").size();
	if (args.empty() || args[0] == '-')
		send(args, out);
	else
		runCommand(env + args + " >/dev/null 2>&1 &");
	const std::string mark = "first page: ", text = waitForLog(mark) ? log() : mark;
	const size_t at = text.find(mark) + mark.size();
	return text.substr(at, text.find('\n', at) - at);
}

static int startInBackground(const std::string &cmd)
{
	std::string pid;
	runCommand(cmd + " >/dev/null 2>&1 & echo $!", &pid);
	return atoi(pid.c_str());
}

X11Display::X11Display()
{
	if (runCommand("command -v Xvfb && command -v openbox && command -v xdotool") != 0)
		return;
	// Xvfb picks a free display itself and names it once it takes connections.
	const std::string number = makeTempDir("x11") + "/display";
	xvfb = startInBackground("Xvfb -displayfd 3 -screen 0 1024x900x24 -nolisten tcp 3>'" + number + "'");
	ok = pump(10.0, [&] {
		display = atoi(readFile(number).c_str());
		return readFile(number).find('\n') != std::string::npos;
	});
	if (ok)
		openbox = startInBackground(env() + "openbox");
}

X11Display::~X11Display()
{
	for (int pid : {openbox, xvfb})
		if (pid > 0)
			kill(pid, SIGTERM);
}

std::string X11Display::env() const
{
	return "DISPLAY=:" + std::to_string(display) +
	       " ELM_DISPLAY=x11 ELM_ENGINE=software_x11 ECORE_EVAS_ENGINE=software_x11 ";
}

int X11Display::xdotool(const std::string &args) const
{
	return runCommand("DISPLAY=:" + std::to_string(display) + " timeout 30 xdotool " + args);
}
} // namespace memo_test
