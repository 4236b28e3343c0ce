// The edit view's side of the voice panels. The recorder and the player are not part of
// the app yet: their fields stay null, and these helpers say where they would come in.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"

bool MemoEditView::__isRecording() const
{
	// A recorder holds its handle only while it records; without the recorder nothing records here.
	return false;
}

bool MemoEditView::__stopRecording()
{
	// The recorder stops here and reports whether the recording reached one second.
	MEMO_LOGI("no recording to stop");
	return true;
}

bool MemoEditView::__isVoicePanelFree() const
{
	if (__player)
		return __isPlayerDeleted == 1;
	return !__recorder || __isRecorderDeleted == 1;
}

void MemoEditView::__deleteRecorder()
{
	if (!__recorder) {
		MEMO_LOGE("Recorder is not NULL");
		return;
	}
	__recorder = nullptr;
}

void MemoEditView::__destroyPlayer()
{
	__player = nullptr;
}

void MemoEditView::__createPlayer(bool withDeleteButton)
{
	char *path = nullptr;
	MemoDbMgr *db = MemoDbMgr::getInstance();
	if (db && __vrUUID)
		db->getFilePathN(__vrUUID, &path);
	MEMO_LOGI("a player%s would show %s", withDeleteButton ? " with its delete button" : "", path ? path : "(none)");
	free(path);
}

char *MemoEditView::__getVrPathN(const char *uuid)
{
	if (!uuid || !__UUID || !__mediaPath) {
		MEMO_LOGE("input or __UUID is  NULL");
		return nullptr;
	}
	Eina_List *entries = ecore_file_ls(__mediaPath);
	if (!entries)
		return nullptr;
	const std::string wanted = std::string(uuid) + ".amr";
	std::string found;
	Eina_List *l = nullptr;
	void *data = nullptr;
	// The first pass matches an entry one byte longer than "<uuid>.amr" and takes the wanted name; an entry
	// equal to it does not match here.
	EINA_LIST_FOREACH(entries, l, data)
	{
		const char *name = static_cast<const char *>(data);
		const size_t nameLen = strlen(name);
		const size_t shorter = nameLen < wanted.size() ? nameLen : wanted.size();
		long result = memcmp(name, wanted.c_str(), shorter);
		if (result == 0)
			result = static_cast<long>(nameLen) - static_cast<long>(wanted.size());
		if (result == 1) {
			found = std::string(__mediaPath) + wanted;
			break;
		}
	}
	if (found.empty()) {
		EINA_LIST_FOREACH(entries, l, data)
		{
			const char *name = static_cast<const char *>(data);
			if (strstr(name, uuid)) {
				found = std::string(__mediaPath) + name;
				break;
			}
		}
	}
	EINA_LIST_FREE(entries, data)
	free(data);
	if (found.empty() || !ecore_file_exists(found.c_str()))
		return nullptr;
	return strdup(found.c_str());
}

void MemoEditView::__audioBtnCb()
{
	// The recorder's panel opens here once the recorder is part of the app.
	MEMO_LOGI("no recorder to open");
}
