// The application window: elm_win, conformant, and the base layout that holds the base view.
#include "WWindowController.h"

#include <cstdio>
#include <cstdlib>
#include <libintl.h>

#include <app.h>
#include <desktop/app_install.h>

#include "WDefine.h"
#include "WViewController.h"

namespace app_assist
{

static const char *BASE_LAYOUT_GROUP = "app-assist/base_layout";
static const int DEFAULT_WIN_WIDTH = 480;
static const int DEFAULT_WIN_HEIGHT = 800;

// The theme of the base layout: APP_ASSIST_EDJ, else the one of an installed tree, else the one built with the
// framework.
static const char *__baseLayoutEdj()
{
	const char *path = getenv("APP_ASSIST_EDJ");
	if (path && *path)
		return path;
	static char *installed = desktop_app_install_path_get("app-assist/app-assist.edj");
	return installed ? installed : APP_ASSIST_EDJ_PATH;
}

// The window's first size: WAPP_WINDOW_SIZE="<width>x<height>" overrides the default.
static void __initialSize(int *w, int *h)
{
	*w = DEFAULT_WIN_WIDTH;
	*h = DEFAULT_WIN_HEIGHT;
	const char *size = getenv("WAPP_WINDOW_SIZE");
	int envW = 0, envH = 0;
	if (size && sscanf(size, "%dx%d", &envW, &envH) == 2 && envW > 0 && envH > 0) {
		*w = envW;
		*h = envH;
	}
}

WWindowController::WWindowController(const char *name, Elm_Win_Type winType)
    : __name(name ? name : ""), __title(__name), __win(nullptr), __conformant(nullptr), __baseLayout(nullptr),
      __baseView(nullptr)
{
	__win = elm_win_add(nullptr, __name.c_str(), winType);
	if (!__win) {
		WERROR("elm_win_add failed for %s", __name.c_str());
		return;
	}
	elm_win_title_set(__win, __name.c_str());
	elm_win_autodel_set(__win, EINA_FALSE);
	if (elm_win_wm_rotation_supported_get(__win)) {
		const int rotations[4] = {0, 90, 180, 270};
		elm_win_wm_rotation_available_rotations_set(__win, rotations, 4);
	}
	evas_object_smart_callback_add(__win, "delete,request", __deleteRequestCb, this);
	evas_object_smart_callback_add(__win, "language,changed", __languageChangedCb, this);
	evas_object_event_callback_add(__win, EVAS_CALLBACK_DEL, __winDelCb, this);

	__conformant = elm_conformant_add(__win);
	evas_object_size_hint_weight_set(__conformant, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_win_resize_object_add(__win, __conformant);
	elm_win_conformant_set(__win, EINA_TRUE);
	evas_object_show(__conformant);

	__baseLayout = elm_layout_add(__conformant);
	if (!elm_layout_file_set(__baseLayout, __baseLayoutEdj(), BASE_LAYOUT_GROUP))
		WERROR("Base layout group %s not found in %s", BASE_LAYOUT_GROUP, __baseLayoutEdj());
	evas_object_size_hint_weight_set(__baseLayout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(__baseLayout, EVAS_HINT_FILL, EVAS_HINT_FILL);
	elm_object_content_set(__conformant, __baseLayout);
	evas_object_show(__baseLayout);

	int w, h;
	__initialSize(&w, &h);
	evas_object_resize(__win, w, h);
	evas_object_show(__win);
}

WWindowController::~WWindowController()
{
	if (!__win)
		return;
	Evas_Object *win = __win;
	evas_object_smart_callback_del_full(win, "delete,request", __deleteRequestCb, this);
	evas_object_smart_callback_del_full(win, "language,changed", __languageChangedCb, this);
	evas_object_event_callback_del_full(win, EVAS_CALLBACK_DEL, __winDelCb, this);
	if (__baseView && __baseView->getEvasObj())
		evas_object_event_callback_del_full(__baseView->getEvasObj(), EVAS_CALLBACK_DEL, __baseViewDelCb, this);
	__win = __conformant = __baseLayout = nullptr;
	__baseView = nullptr;
	evas_object_del(win);
}

Evas_Object *WWindowController::getEvasObj() const
{
	return __win;
}

WViewController *WWindowController::getBaseViewController() const
{
	return __baseView;
}

bool WWindowController::attachBaseViewController(WViewController *viewController)
{
	if (!viewController) {
		WERROR("viewController is null");
		return false;
	}
	if (!__baseLayout) {
		WERROR("The window of %s does not exist", __name.c_str());
		return false;
	}
	if (viewController == __baseView)
		return true;
	if (!viewController->getEvasObj() && !viewController->create(__baseLayout, nullptr)) {
		WERROR("Base view %s could not be created", viewController->getClassName());
		return false;
	}
	if (__baseView && __baseView->getEvasObj()) {
		// The previous base view goes with its object.
		evas_object_event_callback_del_full(__baseView->getEvasObj(), EVAS_CALLBACK_DEL, __baseViewDelCb, this);
		__baseView->destroy();
	}
	__baseView = viewController;
	Evas_Object *obj = viewController->getEvasObj();
	evas_object_event_callback_add(obj, EVAS_CALLBACK_DEL, __baseViewDelCb, this);
	elm_object_part_content_set(__baseLayout, "elm.swallow.content", obj);
	evas_object_show(obj);
	return true;
}

Evas_Object *WWindowController::getBaseLayoutEvasObj() const
{
	return __baseLayout;
}

Evas_Object *WWindowController::getConformantEvasObj() const
{
	return __conformant;
}

const char *WWindowController::getName() const
{
	return __name.c_str();
}

void WWindowController::setTitle(const char *text, const char *domain)
{
	__title = text ? text : "";
	__titleDomain = domain ? domain : "";
	__applyTitle();
}

void WWindowController::__applyTitle()
{
	if (!__win)
		return;
	const char *title = __title.c_str();
	if (!__titleDomain.empty() && !__title.empty())
		title = dgettext(__titleDomain.c_str(), title);
	elm_win_title_set(__win, title);
}

void WWindowController::__languageChangedCb(void *data, Evas_Object *, void *)
{
	static_cast<WWindowController *>(data)->__applyTitle();
}

void WWindowController::__deleteRequestCb(void *, Evas_Object *, void *)
{
	// The loop ends; the views are torn down after onTerminate, with the window.
	ui_app_exit();
}

void WWindowController::__winDelCb(void *data, Evas *, Evas_Object *, void *)
{
	WWindowController *self = static_cast<WWindowController *>(data);
	self->__win = self->__conformant = self->__baseLayout = nullptr;
	self->__baseView = nullptr;
}

void WWindowController::__baseViewDelCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<WWindowController *>(data)->__baseView = nullptr;
}

} // namespace app_assist
