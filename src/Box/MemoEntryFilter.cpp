// The markup filter of every body entry: the text steps (MemoEntryFilterMarkup.cpp), then the image
// steps (MemoEntryFilterImages.cpp), and the insertion now or once the workers have shrunk the pictures.
#include "Box/MemoBoxItem.h"

#include <app_i18n.h>
#include <notification_status.h>

#include <cstring>

#include "MemoBoxItemPrivate.h"
#include "MemoEntryFilterTags.h"
#include "MemoLog.h"

void MemoBoxItem::__entryFilter(void *data, Evas_Object *entry, char **text)
{
	(void)entry;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (!self || !text || !*text)
		return;

	if (self->__limit.max_char_count <= 0) {
		MEMO_LOGI("No characters left in this memo.");
		free(*text);
		*text = nullptr;
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"));
		return;
	}

	std::string work = memoEntryFilterMarkup(
	    *text, [self] { return self->__listener ? self->__listener->onEntryCheckImageCount() : -1; });

	std::vector<__ResizeRequest> queue;
	self->__adoptFixedSizeTags(work, queue);
	self->__adoptImageTags(work);

	free(*text);
	*text = nullptr;
	if (queue.empty()) {
		*text = strdup(work.c_str());
		return;
	}
	// Appended rather than replaced: a second insertion that arrives while the first still waits
	// for its workers would otherwise drop the first one's text.
	self->__pendingText += work;
	self->__queueResizeWorkers(queue);
}
