/* Theme tables of the process: the last colour and font tables set, re-applied when the theme or the font
   size key changes, followed by the changed callbacks of that kind. */
#include <uxt_theme.h>

#include <dlog.h>
#include <stdint.h>
#include <stdlib.h>
#include <vconf.h>

#include "ui/uxt_theme_tables.h"

#define CHANGED_TYPES 2

typedef struct {
	Uxt_Theme_Changed_Cb func;
	void *data;
	Eina_Bool deleted;
} Changed_Cb;

static Eina_Bool __enabled;
static Uxt_Theme_Color_Table *__activeColor;
static Uxt_Theme_Font_Table *__activeFont;
static Eina_List *__changedCbs[CHANGED_TYPES]; /* Changed_Cb */
static int __walking[CHANGED_TYPES];

static void __purge(int type)
{
	Eina_List *l, *next;
	Changed_Cb *cb;
	EINA_LIST_FOREACH_SAFE(__changedCbs[type], l, next, cb)
	{
		if (cb->deleted) {
			__changedCbs[type] = eina_list_remove_list(__changedCbs[type], l);
			free(cb);
		}
	}
}

/* Callbacks added while running wait for the next change; removed ones are skipped. */
static void __fire(int type)
{
	unsigned int count = eina_list_count(__changedCbs[type]);
	unsigned int i = 0;
	Eina_List *l;
	Changed_Cb *cb;
	__walking[type]++;
	EINA_LIST_FOREACH(__changedCbs[type], l, cb)
	{
		if (i++ >= count)
			break;
		if (!cb->deleted)
			cb->func((void *)(intptr_t)type, cb->data);
	}
	if (--__walking[type] == 0)
		__purge(type);
}

static void __themeKeyCb(keynode_t *node, void *data)
{
	(void)node;
	(void)data;
	LOGI("theme changed");
	uxt_color_table_apply(__activeColor);
	__fire(UXT_THEME_CHANGED_TYPE_COLOR);
}

static void __fontKeyCb(keynode_t *node, void *data)
{
	(void)node;
	(void)data;
	LOGI("font size changed");
	uxt_font_table_apply(__activeFont);
	__fire(UXT_THEME_CHANGED_TYPE_FONT);
}

int uxt_theme_set_changeable_ui_enabled(Eina_Bool enabled)
{
	enabled = enabled ? EINA_TRUE : EINA_FALSE;
	if (enabled == __enabled)
		return UXT_ERROR_NONE;
	if (enabled) {
		if (vconf_notify_key_changed(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, __themeKeyCb, NULL) != VCONF_OK ||
		    vconf_notify_key_changed(VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE, __fontKeyCb, NULL) != VCONF_OK) {
			LOGE("cannot watch the theme keys");
			vconf_ignore_key_changed(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, __themeKeyCb);
			return UXT_ERROR_INVALID_OPERATION;
		}
	} else {
		vconf_ignore_key_changed(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, __themeKeyCb);
		vconf_ignore_key_changed(VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE, __fontKeyCb);
	}
	__enabled = enabled;
	return UXT_ERROR_NONE;
}

Uxt_Theme_Color_Table *uxt_theme_add_color_table(const char *file_path)
{
	if (!file_path) {
		LOGE("file_path is NULL");
		return NULL;
	}
	return uxt_color_table_load(file_path);
}

int uxt_theme_set_color_table(Uxt_Theme_Color_Table *table)
{
	if (!table) {
		LOGE("table is NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	__activeColor = table;
	uxt_color_table_apply(table);
	return UXT_ERROR_NONE;
}

int uxt_theme_delete_color_table(Uxt_Theme_Color_Table *table)
{
	if (!table) {
		LOGE("table is NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	if (__activeColor == table)
		__activeColor = NULL;
	uxt_color_table_free(table);
	return UXT_ERROR_NONE;
}

Uxt_Theme_Font_Table *uxt_theme_add_font_table(const char *file_path)
{
	if (!file_path) {
		LOGE("file_path is NULL");
		return NULL;
	}
	return uxt_font_table_load(file_path);
}

int uxt_theme_set_font_table(Uxt_Theme_Font_Table *table)
{
	if (!table) {
		LOGE("table is NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	__activeFont = table;
	uxt_font_table_apply(table);
	return UXT_ERROR_NONE;
}

int uxt_theme_delete_font_table(Uxt_Theme_Font_Table *table)
{
	if (!table) {
		LOGE("table is NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	if (__activeFont == table)
		__activeFont = NULL;
	uxt_font_table_free(table);
	return UXT_ERROR_NONE;
}

int uxt_theme_add_changed_callback(int type, Uxt_Theme_Changed_Cb func, void *data)
{
	if (type < 0 || type >= CHANGED_TYPES || !func) {
		LOGE("invalid parameter: type %d, func %p", type, (void *)(intptr_t)func);
		return UXT_ERROR_INVALID_PARAMETER;
	}
	Changed_Cb *cb = calloc(1, sizeof(*cb));
	if (!cb) {
		LOGE("out of memory");
		return UXT_ERROR_OUT_OF_MEMORY;
	}
	cb->func = func;
	cb->data = data;
	__changedCbs[type] = eina_list_append(__changedCbs[type], cb);
	return UXT_ERROR_NONE;
}

int uxt_theme_delete_changed_callback(int type, Uxt_Theme_Changed_Cb func)
{
	if (type < 0 || type >= CHANGED_TYPES || !func) {
		LOGE("invalid parameter: type %d, func %p", type, (void *)(intptr_t)func);
		return UXT_ERROR_INVALID_PARAMETER;
	}
	Eina_List *l;
	Changed_Cb *cb;
	EINA_LIST_FOREACH(__changedCbs[type], l, cb)
	{
		if (cb->func != func || cb->deleted)
			continue;
		if (__walking[type] > 0) {
			cb->deleted = EINA_TRUE;
		} else {
			__changedCbs[type] = eina_list_remove_list(__changedCbs[type], l);
			free(cb);
		}
		return UXT_ERROR_NONE;
	}
	LOGE("callback %p of type %d is not registered", (void *)(intptr_t)func, type);
	return UXT_ERROR_NO_DATA;
}
