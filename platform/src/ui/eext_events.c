/* Hardware back/more keys routed to the one object that should take them.
 *
 * Each canvas gets a hidden rectangle that grabs the keys, so they arrive whatever has the focus. On key
 * release the target is chosen among the objects holding a callback of that type: visible ones only (with
 * every smart parent and clipper visible), on the highest layer, under the top-level object highest in the
 * stacking order, and within it the topmost, deepest member. Only that object's callbacks run.
 *
 * The keys are grabbed exclusively: the focused widget never sees them, so no toolkit binding of its own
 * (Escape pops a naviframe, closes a popup) acts on the same press.
 *
 * A window close request is not taken as back: closing the window must always be able to end the app. */
#include <efl_extension.h>

#include <canvas/efl_canvas_group.eo.h>
#include <dlog.h>
#include <stdint.h>
#include <string.h>

#include "ui/eext_events_keys.h"

typedef struct {
	Eext_Callback_Type type;
	Eext_Event_Cb func;
	void *data;
	Eina_Bool deleted;
} Eext_Cb;

typedef struct {
	Evas_Object *obj;
	Eina_List *cbs; /* Eext_Cb, in registration order */
	int walking;
	Eina_Bool dead; /* obj is gone; freed when the last walk ends */
} Eext_Target;

typedef struct {
	Evas *evas;
	Evas_Object *grabber;
} Eext_Grabber;

static Eina_List *__targets;  /* Eext_Target */
static Eina_List *__grabbers; /* Eext_Grabber */

static void __targetFree(Eext_Target *target)
{
	Eext_Cb *cb;
	EINA_LIST_FREE(target->cbs, cb)
	free(cb);
	free(target);
}

static void __targetPurge(Eext_Target *target)
{
	Eina_List *l, *next;
	Eext_Cb *cb;
	EINA_LIST_FOREACH_SAFE(target->cbs, l, next, cb)
	{
		if (cb->deleted) {
			target->cbs = eina_list_remove_list(target->cbs, l);
			free(cb);
		}
	}
}

static Eext_Target *__targetFind(const Evas_Object *obj)
{
	Eina_List *l;
	Eext_Target *target;
	EINA_LIST_FOREACH(__targets, l, target)
	{
		if (target->obj == obj && !target->dead)
			return target;
	}
	return NULL;
}

static void __targetDelCb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	Eext_Target *target = data;
	__targets = eina_list_remove(__targets, target);
	if (target->walking > 0)
		target->dead = EINA_TRUE;
	else
		__targetFree(target);
}

static Eina_Bool __hasType(const Eext_Target *target, Eext_Callback_Type type)
{
	const Eina_List *l;
	const Eext_Cb *cb;
	EINA_LIST_FOREACH(target->cbs, l, cb)
	{
		if (cb->type == type && !cb->deleted)
			return EINA_TRUE;
	}
	return EINA_FALSE;
}

/* An object counts as shown only if it, each smart parent and each of their clippers are visible. */
static Eina_Bool __isShown(const Evas_Object *obj)
{
	for (const Evas_Object *o = obj; o; o = evas_object_smart_parent_get(o)) {
		if (!evas_object_visible_get(o))
			return EINA_FALSE;
		for (const Evas_Object *clip = evas_object_clip_get(o); clip; clip = evas_object_clip_get(clip)) {
			if (!evas_object_visible_get(clip))
				return EINA_FALSE;
		}
	}
	return EINA_TRUE;
}

static Evas_Object *__topParent(Evas_Object *obj)
{
	Evas_Object *parent;
	while ((parent = evas_object_smart_parent_get(obj)))
		obj = parent;
	return obj;
}

static Eina_Bool __isCandidate(const Eina_List *candidates, const Evas_Object *obj)
{
	const Eina_List *l;
	const Eext_Target *target;
	EINA_LIST_FOREACH(candidates, l, target)
	{
		if (target->obj == obj)
			return EINA_TRUE;
	}
	return EINA_FALSE;
}

/* Topmost member first, and a member's own members before the member itself, so that the deepest
   object wins over the containers around it. */
static Evas_Object *__searchMembers(Evas_Object *obj, const Eina_List *candidates)
{
	/* Asking a primitive for its members makes Evas log an error, so only groups are opened. */
	Eina_List *members = efl_isa(obj, EFL_CANVAS_GROUP_CLASS) ? evas_object_smart_members_get(obj) : NULL;
	Evas_Object *found = NULL;
	Eina_List *l;
	Evas_Object *member;
	EINA_LIST_REVERSE_FOREACH(members, l, member)
	{
		if ((found = __searchMembers(member, candidates)))
			break;
	}
	eina_list_free(members);
	if (!found && __isCandidate(candidates, obj))
		found = obj;
	return found;
}

static Evas_Object *__chooseTarget(Evas *evas, Eext_Callback_Type type)
{
	Eina_List *candidates = NULL;
	Eina_List *roots = NULL;
	Eina_List *l;
	Eext_Target *target;
	int topLayer = 0;

	EINA_LIST_FOREACH(__targets, l, target)
	{
		if (target->dead || evas_object_evas_get(target->obj) != evas || !__hasType(target, type) ||
		    !__isShown(target->obj))
			continue;
		int layer = evas_object_layer_get(target->obj);
		if (candidates && layer < topLayer)
			continue;
		if (candidates && layer > topLayer) {
			candidates = eina_list_free(candidates);
			roots = eina_list_free(roots);
		}
		topLayer = layer;
		candidates = eina_list_append(candidates, target);
		Evas_Object *root = __topParent(target->obj);
		if (!eina_list_data_find(roots, root))
			roots = eina_list_append(roots, root);
	}

	Evas_Object *chosen = NULL;
	for (Evas_Object *o = evas_object_top_get(evas); o && !chosen; o = evas_object_below_get(o)) {
		if (eina_list_data_find(roots, o))
			chosen = __searchMembers(o, candidates);
	}
	eina_list_free(candidates);
	eina_list_free(roots);
	return chosen;
}

/* Runs the callbacks of the type that existed when the key came, surviving deletion of the object or of
   callbacks from inside a callback. */
static void __dispatch(Eext_Target *target, Eext_Callback_Type type)
{
	Evas_Object *obj = target->obj;
	unsigned int count = eina_list_count(target->cbs);
	unsigned int i = 0;
	Eina_List *l;
	Eext_Cb *cb;

	target->walking++;
	EINA_LIST_FOREACH(target->cbs, l, cb)
	{
		if (i++ >= count || target->dead)
			break;
		if (cb->type != type || cb->deleted)
			continue;
		cb->func(cb->data, obj, (void *)(intptr_t)type);
	}
	target->walking--;
	if (target->walking > 0)
		return;
	if (target->dead)
		__targetFree(target);
	else
		__targetPurge(target);
}

static void __keyUpCb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	const Evas_Event_Key_Up *ev = event_info;
	if (!ev || !ev->keyname || (ev->event_flags & EVAS_EVENT_FLAG_ON_HOLD))
		return;
	Eext_Callback_Type type;
	if (!eext_key_type_get(ev->keyname, &type))
		return;
	Evas_Object *chosen = __chooseTarget(e, type);
	if (!chosen) {
		LOGI("no object takes key %s", ev->keyname);
		return;
	}
	Eext_Target *target = __targetFind(chosen);
	if (target)
		__dispatch(target, type);
}

static void __grabberDelCb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	Eext_Grabber *grabber = data;
	__grabbers = eina_list_remove(__grabbers, grabber);
	free(grabber);
}

static Eina_Bool __grabberEnsure(Evas *evas)
{
	Eina_List *l;
	Eext_Grabber *grabber;
	EINA_LIST_FOREACH(__grabbers, l, grabber)
	{
		if (grabber->evas == evas)
			return EINA_TRUE;
	}
	grabber = calloc(1, sizeof(*grabber));
	if (!grabber) {
		LOGE("out of memory");
		return EINA_FALSE;
	}
	grabber->evas = evas;
	grabber->grabber = evas_object_rectangle_add(evas);
	evas_object_pass_events_set(grabber->grabber, EINA_TRUE);
	/* Exclusive, so that the keys reach nothing else: Elementary binds Escape itself (a naviframe pops, a
	   popup or context popup closes), and a second handling of the same press would take two steps back. */
	for (const char *const *key = eext_key_names(); *key; key++) {
		if (!evas_object_key_grab(grabber->grabber, *key, 0, 0, EINA_TRUE) &&
		    !evas_object_key_grab(grabber->grabber, *key, 0, 0, EINA_FALSE))
			LOGE("cannot grab key %s", *key);
	}
	evas_object_event_callback_add(grabber->grabber, EVAS_CALLBACK_KEY_UP, __keyUpCb, NULL);
	evas_object_event_callback_add(grabber->grabber, EVAS_CALLBACK_DEL, __grabberDelCb, grabber);
	__grabbers = eina_list_append(__grabbers, grabber);
	return EINA_TRUE;
}

void eext_object_event_callback_add(Evas_Object *obj, Eext_Callback_Type type, Eext_Event_Cb func, void *data)
{
	if (!obj || !func || type >= EEXT_CALLBACK_LAST) {
		LOGE("invalid parameter: obj %p, type %d, func %p", (void *)obj, (int)type, (void *)(intptr_t)func);
		return;
	}
	Evas *evas = evas_object_evas_get(obj);
	if (!evas || !__grabberEnsure(evas)) {
		LOGE("object %p has no canvas", (void *)obj);
		return;
	}
	Eext_Target *target = __targetFind(obj);
	if (!target) {
		target = calloc(1, sizeof(*target));
		if (!target) {
			LOGE("out of memory");
			return;
		}
		target->obj = obj;
		evas_object_event_callback_add(obj, EVAS_CALLBACK_DEL, __targetDelCb, target);
		__targets = eina_list_append(__targets, target);
	}
	Eext_Cb *cb = calloc(1, sizeof(*cb));
	if (!cb) {
		LOGE("out of memory");
		return;
	}
	cb->type = type;
	cb->func = func;
	cb->data = data;
	target->cbs = eina_list_append(target->cbs, cb);
}

void *eext_object_event_callback_del(Evas_Object *obj, Eext_Callback_Type type, Eext_Event_Cb func)
{
	if (!obj || !func || type >= EEXT_CALLBACK_LAST) {
		LOGE("invalid parameter: obj %p, type %d, func %p", (void *)obj, (int)type, (void *)(intptr_t)func);
		return NULL;
	}
	Eext_Target *target = __targetFind(obj);
	if (!target)
		return NULL;
	Eina_List *l;
	Eext_Cb *cb;
	EINA_LIST_REVERSE_FOREACH(target->cbs, l, cb)
	{
		if (cb->type != type || cb->func != func || cb->deleted)
			continue;
		void *data = cb->data;
		if (target->walking > 0) {
			cb->deleted = EINA_TRUE;
		} else {
			target->cbs = eina_list_remove_list(target->cbs, l);
			free(cb);
		}
		return data;
	}
	return NULL;
}
