// Cell sizes by scale and orientation, and the scroll position kept across a rotation.
#include "List/MemoGridControl.h"

#include "DataBase/MemoDbMgr.h"
#include "List/MemoItemList.h"
#include "MemoApp.h"
#include "MemoLog.h"

namespace
{
// One row of the size table: cell width and height in base-scale units, and the row step in pixels that
// converts a scroll position between the orientations.
struct GridSize {
	int width, height, rowStep;
};

GridSize __gridSizeFor(bool portrait, double scale)
{
	// Exact comparisons: the device scales are these doubles.
	if (portrait) {
		if (scale == 1.8)
			return {338, 293, 202};
		if (scale == 3.8)
			return {360, 293, 293};
		return {350, 293, 293};
	}
	if (scale == 1.8)
		return {376, 293, 202};
	if (scale == 3.8)
		return {426, 293, 305};
	return {416, 305, 305};
}
} // namespace

void MemoGridControl::__setGridSize(Evas_Object *gengrid)
{
	const double scale = elm_config_scale_get();
	MEMO_LOGI("scale factor : %f", scale);
	__scrollEventCount = 0;
	const bool portrait = gIsPortrait;
	const GridSize size = __gridSizeFor(portrait, scale);
	const int y = savedScrollY;
	const int step = size.rowStep;
	// Portrait shows fewer columns than landscape, so the same memo stands on a later row.
	if (portrait && __scrolledInLandscape)
		restoreScrollY = (y / step) * 3 / 2 * step + y % step;
	else if (!portrait && __scrolledInPortrait)
		restoreScrollY = (y / step) * 2 / 3 * step + y % step;
	else
		restoreScrollY = y;
	const double base = elm_app_base_scale_get();
	elm_gengrid_item_size_set(gengrid, static_cast<Evas_Coord>(scale * size.width / base),
	                          static_cast<Evas_Coord>(scale * size.height / base));
}

void MemoGridControl::__scrollCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoGridControl *self = static_cast<MemoGridControl *>(data);
	if (!self)
		return;
	Evas_Coord x = 0, y = 0;
	elm_scroller_region_get(obj, &x, &y, nullptr, nullptr);
	self->__scrollEventCount++;
	savedScrollX = x;
	// The first event after a relayout is the relayout's own scroll, not the user's.
	if (self->__scrollEventCount > 1) {
		self->__scrolledInPortrait = false;
		self->__scrolledInLandscape = false;
		restoreScrollY = y;
		savedScrollY = y;
		if (gIsPortrait)
			self->__scrolledInPortrait = true;
		else
			self->__scrolledInLandscape = true;
	}
}

void MemoGridControl::restoreScrollPosition()
{
	Evas_Object *gengrid = getEvasObj();
	MemoItemList *list = MemoDbMgr::getInstance()->getVisibleMemoListN();
	if (gengrid && list->getCount() >= 1) {
		Evas_Coord childWidth = 0, childHeight = 0;
		elm_scroller_child_size_get(gengrid, &childWidth, &childHeight);
		const Evas_Coord y = restoreScrollY < childHeight ? restoreScrollY : childHeight;
		Evas_Coord width = 0, height = 0;
		elm_scroller_region_get(gengrid, nullptr, nullptr, &width, &height);
		elm_scroller_region_show(gengrid, savedScrollX, y, width, height);
	}
	delete list;
}
