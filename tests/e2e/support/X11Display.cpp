#include "X11Display.h"

#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>

#include "TestEnv.h"

namespace memo_test
{
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
	struct stat st;
	for (__display = 60 + getpid() % 30; stat(("/tmp/.X11-unix/X" + std::to_string(__display)).c_str(), &st) == 0;)
		__display++;
	__xvfb = startInBackground("Xvfb :" + std::to_string(__display) + " -screen 0 1024x900x24 -nolisten tcp");
	__ok = pump(10.0, [this] { return xdotool("getmouselocation >/dev/null 2>&1") == 0; });
	if (__ok)
		__openbox = startInBackground("DISPLAY=:" + std::to_string(__display) + " openbox");
}

X11Display::~X11Display()
{
	for (int pid : {__openbox, __xvfb})
		if (pid > 0)
			kill(pid, SIGTERM);
}

std::string X11Display::env() const
{
	return "DISPLAY=:" + std::to_string(__display) +
	       " ELM_DISPLAY=x11 ELM_ENGINE=software_x11 ECORE_EVAS_ENGINE=software_x11 ";
}

int X11Display::xdotool(const std::string &args, std::string *out) const
{
	return runCommand("DISPLAY=:" + std::to_string(__display) + " xdotool " + args, out);
}
} // namespace memo_test
