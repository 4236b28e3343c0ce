#ifndef __VCONF_KEYS_H__
#define __VCONF_KEYS_H__

/* Keys of the device state. On the desktop they live in the vconf store and can be set with
   `vconftool set`; the ones marked "seeded" read as a default while unset. */

/* Language and region */
#define VCONFKEY_LANGSET "db/menu_widget/language"          /* string, e.g. "en_US.UTF-8"; seeded from $LANG */
#define VCONFKEY_REGIONFORMAT "db/menu_widget/regionformat" /* string; seeded from $LANG */
#define VCONFKEY_REGIONFORMAT_TIME1224 "db/menu_widget/regionformat_time1224" /* int; seeded 1 */
enum {
	VCONFKEY_TIME_FORMAT_12 = 1,
	VCONFKEY_TIME_FORMAT_24,
};
#define VCONFKEY_SETAPPL_TIMEZONE_ID "db/setting/timezone_id" /* string, e.g. "Europe/Berlin" */

/* Settings */
#define VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT "db/setting/change_ui/theme"             /* int */
#define VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE "db/setting/accessibility/font_size" /* int, 0 small .. 4 giant */
#define VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_NAME "db/setting/accessibility/font_name" /* string */
#define VCONFKEY_SETAPPL_SOUND_STATUS_BOOL "db/setting/sound/sound_on"                /* bool */
#define VCONFKEY_SETAPPL_TOUCH_SOUNDS_BOOL "db/setting/sound/touch_sounds"            /* bool */
#define VCONFKEY_SETAPPL_AUTO_ROTATE_SCREEN_BOOL "db/setting/auto_rotate_screen"      /* bool */
#define VCONFKEY_SETAPPL_DEVICE_NAME_STR "db/setting/device_name"                     /* string */
#define VCONFKEY_SETAPPL_PSMODE "db/setting/psmode"                                   /* int, 0 off; seeded 0 */

/* Calls */
#define VCONFKEY_CALL_STATE "memory/call/state" /* int; seeded 0 */
enum {
	VCONFKEY_CALL_OFF = 0x00,
	VCONFKEY_CALL_VOICE_CONNECTING,
	VCONFKEY_CALL_VOICE_ACTIVE,
	VCONFKEY_CALL_VIDEO_CONNECTING,
	VCONFKEY_CALL_VIDEO_ACTIVE,
	VCONFKEY_CALL_STATE_MAX
};

/* Power manager */
#define VCONFKEY_PM_STATE "memory/pm/state" /* int */
enum { VCONFKEY_PM_STATE_NORMAL = 1, VCONFKEY_PM_STATE_LCDDIM, VCONFKEY_PM_STATE_LCDOFF, VCONFKEY_PM_STATE_SLEEP };

/* Lock screen */
#define VCONFKEY_IDLE_LOCK_STATE "memory/idle_lock/state" /* int */
enum { VCONFKEY_IDLE_UNLOCK = 0x00, VCONFKEY_IDLE_LOCK };

/* System manager */
#define VCONFKEY_SYSMAN_MMC_STATUS "memory/sysman/mmc" /* int */
enum { VCONFKEY_SYSMAN_MMC_REMOVED = 0, VCONFKEY_SYSMAN_MMC_MOUNTED, VCONFKEY_SYSMAN_MMC_INSERTED_NOT_MOUNTED };
#define VCONFKEY_SYSMAN_LOW_MEMORY "memory/sysman/low_memory" /* int */
enum {
	VCONFKEY_SYSMAN_LOW_MEMORY_NORMAL = 0x01,
	VCONFKEY_SYSMAN_LOW_MEMORY_SOFT_WARNING = 0x02,
	VCONFKEY_SYSMAN_LOW_MEMORY_HARD_WARNING = 0x04
};
#define VCONFKEY_SYSMAN_EARJACK "memory/sysman/earjack" /* int; unset reads as removed */
enum { VCONFKEY_SYSMAN_EARJACK_REMOVED = 0, VCONFKEY_SYSMAN_EARJACK_3WIRE = 1, VCONFKEY_SYSMAN_EARJACK_4WIRE = 3 };

#endif
