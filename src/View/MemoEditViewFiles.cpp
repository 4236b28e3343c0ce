// The files of a memo being saved: the voice and image rows, the thumbnail, and the media folder kept to
// what the memo refers to.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include <Ecore_File.h>

#include "DataBase/MemoDocInfo.h"
#include "DataBase/MemoFileInfo.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

// A memo keeps rows for at most ten images beside its voice file.
static const int MAX_IMAGE_ROWS = 10;
// Thumbnail boxes, for a card with and without a title line.
static const int THUMB_WIDTH = 322;
static const int THUMB_HEIGHT = 263;
static const int THUMB_HEIGHT_WITH_TITLE = 184;
static const int THUMB_CROP_MODE = 3;

bool MemoEditView::__fillFileInfo(MemoFileInfo *file, const char *fileUUID, const char *mime, const char *path)
{
	file->setFileUUID(fileUUID);
	file->setIsDeleted(0);
	file->setIsDirty(1);
	file->setMemoUUID(__UUID);
	file->setMimeType(mime);
	file->setSync2("");
	file->setDisplayName(ecore_file_file_get(path));
	file->setPath(path);
	file->setSize(static_cast<long long>(ecore_file_size(path)));
	return true;
}

void MemoEditView::__collectFiles(MemoDocInfo *record, Eina_List *images, const char *title)
{
	std::vector<MemoFileInfo> files;

	// The voice row comes first.
	if (__vrUUID) {
		char *vrPath = __getVrPathN(__vrUUID);
		if (!vrPath) {
			free(__vrUUID);
			__vrUUID = nullptr;
			MEMO_LOGE("can not get voice file path.");
		} else {
			files.emplace_back();
			__fillFileInfo(&files.back(), __vrUUID, "audio/amr", vrPath);
			record->setVrfileUUID(__vrUUID);
			free(vrPath);
		}
	}

	if (images) {
		int count = static_cast<int>(eina_list_count(images));
		if (count > MAX_IMAGE_ROWS)
			count = MAX_IMAGE_ROWS;
		// The first image whose file exists makes the thumbnail; a vanished one hands the turn on.
		int thumbTurn = 0;
		for (int i = 0; i < count; i++) {
			const char *path = static_cast<const char *>(eina_list_nth(images, i));
			if (!path)
				continue;
			char *uuid = ecore_file_strip_ext(ecore_file_file_get(path));
			files.emplace_back();
			// Every picture is filed as JPEG, whatever it is.
			__fillFileInfo(&files.back(), uuid ? uuid : "", "image/jpeg", path);
			free(uuid);
			if (i == thumbTurn) {
				__createThumbnail(path, title && *title);
				record->setData(__thumbPath ? __thumbPath : "");
				if (!ecore_file_exists(path)) {
					ecore_file_remove(__thumbPath);
					thumbTurn++;
				}
			}
		}
	}

	if (images || __vrUUID)
		__refreshMediaFolder(images);
	else if (__mediaPath)
		ecore_file_recursive_rm(__mediaPath); // opening the memo makes it again

	if (!files.empty()) {
		record->setFileCount(static_cast<int>(files.size()));
		record->copyFileInfos(files.data());
	}
}

bool MemoEditView::__createThumbnail(const char *path, bool hasTitle)
{
	if (!path) {
		MEMO_LOGE("ImgPath is null");
		return false;
	}
	if (__thumbPath) {
		ecore_file_remove(__thumbPath);
		free(__thumbPath);
		__thumbPath = nullptr;
	}
	const std::string thumbDir = std::string(MemoUtil::getDataPath()) + "media/" + (__UUID ? __UUID : "") + "/thumb/";
	if (!ecore_file_mkpath(thumbDir.c_str()) && !ecore_file_is_dir(thumbDir.c_str()))
		return false;
	__thumbPath = strdup((thumbDir + (__UUID ? __UUID : "") + ".jpg").c_str());
	const int orient = MemoUtil::getOrient(path);
	MemoUtil::resizeImage(path, __thumbPath, THUMB_WIDTH, hasTitle ? THUMB_HEIGHT_WITH_TITLE : THUMB_HEIGHT,
	                      THUMB_CROP_MODE);
	MemoUtil::rotateImage(__thumbPath, orient);
	return true;
}

void MemoEditView::__refreshMediaFolder(Eina_List *images)
{
	if (!images)
		MEMO_LOGE("Image list is null. Every image file will be deleted in media folder.");
	if (!__mediaPath) {
		MEMO_LOGE("__mediaPath is null");
		return;
	}
	Eina_List *entries = ecore_file_ls(__mediaPath);
	void *data = nullptr;
	EINA_LIST_FREE(entries, data)
	{
		char *name = static_cast<char *>(data);
		bool keep = false;
		if (eina_str_has_extension(name, ".amr")) {
			keep = __vrUUID && strstr(name, __vrUUID);
		} else if (__vrUUID && strstr(name, __vrUUID)) {
			keep = true;
		} else {
			// The whole list counts: pictures beyond the tenth keep their files.
			Eina_List *l = nullptr;
			void *image = nullptr;
			EINA_LIST_FOREACH(images, l, image)
			{
				if (image && !strcmp(name, ecore_file_file_get(static_cast<const char *>(image)))) {
					keep = true;
					break;
				}
			}
		}
		// "thumb" is a folder: its removal fails and it stays.
		if (!keep)
			ecore_file_remove((std::string(__mediaPath) + name).c_str());
		free(name);
	}
}
