#ifndef TESTS_E2E_SUPPORT_X11DISPLAY_H
#define TESTS_E2E_SUPPORT_X11DISPLAY_H

#include <string>

namespace memo_test
{
// A private X display with a window manager (Xvfb and openbox), on which apps open real windows that take
// real key presses and taps (xdotool). Both stop with the object, each by its own process id.
class X11Display
{
public:
	X11Display();
	~X11Display();
	X11Display(const X11Display &) = delete;
	X11Display &operator=(const X11Display &) = delete;

	// False where Xvfb, openbox or xdotool is missing or the display did not come up.
	bool ok() const { return __ok; }
	// Environment assignments that put a program's windows on this display.
	std::string env() const;
	// Runs xdotool on this display; its exit status, its output in *out.
	int xdotool(const std::string &args, std::string *out = nullptr) const;

private:
	int __display = 0;
	int __xvfb = -1;
	int __openbox = -1;
	bool __ok = false;
};
} // namespace memo_test

#endif
