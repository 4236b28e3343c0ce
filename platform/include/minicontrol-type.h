#ifndef __MINICONTROL_TYPE_H__
#define __MINICONTROL_TYPE_H__

#ifdef __cplusplus
extern "C" {
#endif

/* Where a provider's window is shown. */
typedef enum {
	MINICONTROL_TARGET_VIEWER_QUICK_PANEL = 0x0001,
	MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN = 0x0002,
	MINICONTROL_TARGET_VIEWER_CUSTOM_LOCK_SCREEN = 0x0004,
} minicontrol_target_viewer_e;

/* Provider to viewer. A viewer that wants the provider's window gone (the user dismissed it) sends the
   same code 100 to the provider's callback. */
typedef enum {
	MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE = 100,
	MINICONTROL_PROVIDER_EVENT_REQUEST_ANGLE = 103,
} minicontrol_provider_event_e;

/* Viewer to provider. REPORT_ANGLE carries the angle as the text under "angle" in its bundle. */
typedef enum {
	MINICONTROL_VIEWER_EVENT_REPORT_ANGLE = 200,
	MINICONTROL_VIEWER_EVENT_SHOW = 201,
	MINICONTROL_VIEWER_EVENT_HIDE = 202,
} minicontrol_viewer_event_e;

#ifdef __cplusplus
}
#endif

#endif
