// What the four mini controllers share: sizes, part buttons, the way back into the app, the time part.
#ifndef SRC_RECORDER_MINICONTROLLERSUPPORT_H
#define SRC_RECORDER_MINICONTROLLERSUPPORT_H

#include <Ecore.h>
#include <Elementary.h>
#include <minicontrol-provider.h>

namespace mini_controller
{
// Height of the notification panel's window and of the lock screen's, before scaling.
const int NOTI_HEIGHT = 172;
const int LOCK_HEIGHT = 234;
// Lock-screen width when the window cannot tell the screen's.
const int LOCK_DEFAULT_WIDTH = 720;
// One hour in milliseconds: from there on the time shows hours.
const unsigned long long HOUR_MS = 3600000;
// The viewer's request to take the window away.
const int EVENT_REQUEST_HIDE = 100;

// s * scale / base scale, truncated.
int scaled(int size);
bool isLandscape(int rotation);
// The notification panel's width for the rotation: the screen's height when turned, else its width.
int panelWidth(int rotation);
// The lock screen's width: the window's screen, else the scaled default.
int lockWidth(Evas_Object *win);
// The part object of the layout's edje, or null.
Evas_Object *partObject(Evas_Object *layout, const char *part);
// Adds an evas mouse-up callback on the part object; false when the layout or the part is missing.
bool addPartMouseUp(Evas_Object *layout, const char *part, Evas_Object_Event_Cb cb, void *data);
// Adds a mouse-up button on the part; a missing layout logs "getEvasObj() is nullptr" and adds nothing.
bool addButton(Evas_Object *layout, const char *part, Evas_Object_Event_Cb cb, void *data);
// Makes the quick panel's window: see-through, as wide as the panel at its rotation (stored in *rotation),
// shown.
Evas_Object *createNotiWindow(const char *name, minicontrol_event_cb cb, int *rotation);
// Makes the lock screen's window, which acts on no viewer event: see-through, at the lock-screen size, shown.
Evas_Object *createLockWindow(const char *name);
// Fills the window with a shown layout of the theme's group.
Evas_Object *addLayout(Evas_Object *win, const char *group);
// Hides and deletes *win if any and nulls both it and the layout inside it.
void deleteWindow(Evas_Object **win, Evas_Object **layout);
// Deletes *handler if any and nulls it.
void deleteHandler(Ecore_Event_Handler **handler);
// On a root rotation message to an angle other than *rotation, resizes the quick panel's window to the new
// width and stores the angle; true when it did.
bool rotateNotiWindow(Evas_Object *win, int *rotation, void *event);
// Emits the signal with the source "elm".
void emit(Evas_Object *layout, const char *signal);
// Brings this app back to the front and releases the lock screen (the title of the notification windows).
void resumeApp();
// Sets the time part and clears the other one of the pair, so that only one time shows.
void setTimeParts(Evas_Object *layout, const char *part, const char *text, const char *otherPart);
} // namespace mini_controller

#endif
