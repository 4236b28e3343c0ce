// The image steps of the entry filter: pasted tags are fitted to this display and their files taken
// into the memo's media folder; large pictures are shrunk on workers while the insertion waits.
#include "Box/MemoBoxItem.h"

#include <Ecore_File.h>

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>

#include "MemoBoxItemPrivate.h"
#include "MemoEntryFilterTags.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
const char *const FIXED_SIZE_TAG = "<item absize=240x180";
const char *const SIZED_TAG = "<item size=";

std::string buildTag(int width, int height, const std::string &path)
{
	char tag[2048];
	snprintf(tag, sizeof(tag), "<item size=%dx%d vsize=full href=file://%s></item>", width, height, path.c_str());
	return tag;
}

bool isJpeg(const std::string &path)
{
	return eina_str_has_extension(path.c_str(), ".jpg") || eina_str_has_extension(path.c_str(), ".jpeg");
}

bool isPng(const std::string &path)
{
	return eina_str_has_extension(path.c_str(), ".png");
}

// Copies a file with the kernel doing the work: a camera picture is several megabytes, and a copy through
// user space buffers would hold the main loop for a whole frame. False (and no target) on failure.
bool copyFile(const std::string &from, const std::string &to)
{
	const int in = open(from.c_str(), O_RDONLY | O_CLOEXEC);
	if (in < 0)
		return false;
	const int out = open(to.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
	if (out < 0) {
		close(in);
		return false;
	}
	bool ok = true;
	bool kernelCopy = true;
	for (;;) {
		ssize_t n = -1;
		if (kernelCopy) {
			n = copy_file_range(in, nullptr, out, nullptr, 1 << 30, 0);
			if (n < 0 && (errno == EXDEV || errno == ENOSYS || errno == EINVAL || errno == EOPNOTSUPP)) {
				kernelCopy = false;
				continue;
			}
		} else {
			char buffer[1 << 16];
			n = read(in, buffer, sizeof(buffer));
			for (ssize_t done = 0; n > 0 && done < n;) {
				const ssize_t written = write(out, buffer + done, n - done);
				if (written < 0 && errno != EINTR) {
					n = -1;
					break;
				}
				done += written > 0 ? written : 0;
			}
		}
		if (n < 0 && errno == EINTR)
			continue;
		if (n <= 0) {
			ok = n == 0;
			break;
		}
	}
	close(in);
	if (close(out) != 0)
		ok = false;
	if (!ok)
		unlink(to.c_str());
	return ok;
}

// Where a worker writes the shrunk picture before it replaces the target: beside it, hidden, with the same
// extension (the Evas savers choose the format by it). The rename swaps the file at once, so the entry
// never finds it half written or missing.
std::string workFileFor(const std::string &target)
{
	const size_t slash = target.rfind('/');
	const size_t nameAt = slash == std::string::npos ? 0 : slash + 1;
	return target.substr(0, nameAt) + ".resizing-" + target.substr(nameAt);
}
} // namespace

void MemoBoxItem::__getDisplayWidth(int *width, int *defaultHeight)
{
	if (memoBoxItemIsCheck(__type))
		__getImgSizeCheckType(width, defaultHeight);
	else
		__getImgSizeTextType(width, defaultHeight);
}

// A new name for the picture in <data>media/<uuid>/, keeping its extension; "" when the folder cannot be made.
std::string MemoBoxItem::__mediaFolderNameFor(const std::string &path)
{
	const std::string folder = std::string(MemoUtil::getDataPath()) + "media/" + __memoUuid + "/";
	if (!ecore_file_is_dir(folder.c_str()) && !ecore_file_mkpath(folder.c_str())) {
		MEMO_LOGE("Can not make %s", folder.c_str());
		return "";
	}
	char *uuid = nullptr;
	if (!MemoUtil::createUUIDN(&uuid))
		return "";
	const char *name = ecore_file_file_get(path.c_str());
	const char *dot = name ? strrchr(name, '.') : nullptr;
	std::string target = folder + uuid + (dot ? dot : "");
	free(uuid);
	return target;
}

// A copy of the picture under a new name in the memo's media folder; "" on failure.
std::string MemoBoxItem::__copyIntoMediaFolder(const std::string &path)
{
	const std::string target = __mediaFolderNameFor(path);
	if (target.empty())
		return "";
	if (!copyFile(path, target)) {
		MEMO_LOGE("Copy failed: %s", path.c_str());
		return "";
	}
	return target;
}

// Step 8: tags of the fixed paste size get this display's size and a file of their own in the memo's
// folder. A picture that needs shrinking is not copied here: its worker writes the shrunk file straight
// into the folder, and the insertion waits for it anyway.
void MemoBoxItem::__adoptFixedSizeTags(std::string &text, std::vector<__ResizeRequest> &queue)
{
	size_t pos = 0;
	while ((pos = text.find(FIXED_SIZE_TAG, pos)) != std::string::npos) {
		const size_t end = memoFilterTagEnd(text, pos);
		const std::string path = memoFilterTagPath(text.substr(pos, end - pos));
		if (path.empty() || !ecore_file_exists(path.c_str())) {
			pos = end;
			continue;
		}
		__ResizeRequest request = {path, "", 0, 0, 1.0f};
		int error = 0;
		const bool needsResize =
		    MemoUtil::getInsertImageSize(path.c_str(), &request.width, &request.height, &error, &request.ratio);
		std::string target = needsResize ? __mediaFolderNameFor(path) : __copyIntoMediaFolder(path);
		if (target.empty())
			target = path;
		int width = 0, height = 0;
		__getImgDisplaySize(path.c_str(), &width, &height);
		const std::string tag = buildTag(width, height, target);
		text.replace(pos, end - pos, tag);
		pos += tag.size();

		if (needsResize) {
			request.target = target;
			queue.push_back(request);
		}
	}
}

// Step 9: sized tags are fitted to this display; a file from elsewhere is copied in and, when it is
// large, shrunk by one worker that the insertion does not wait for.
void MemoBoxItem::__adoptImageTags(std::string &text)
{
	const std::string folder = std::string(MemoUtil::getDataPath()) + "media/" + __memoUuid + "/";
	int displayWidth = 0, defaultHeight = 0;
	__getDisplayWidth(&displayWidth, &defaultHeight);

	size_t pos = 0;
	while ((pos = text.find(SIZED_TAG, pos)) != std::string::npos) {
		const size_t end = memoFilterTagEnd(text, pos);
		std::string tag = text.substr(pos, end - pos);
		std::string path = memoFilterTagPath(tag);

		int width = 0, height = 0;
		if (memoFilterTagSize(tag, &width, &height) && width != displayWidth) {
			__getImgDisplaySize(path.c_str(), &width, &height);
			memoFilterTagSetSize(tag, width, height);
		}
		if (!path.empty() && !memoBoxStartsWith(path, folder)) {
			const std::string target = __copyIntoMediaFolder(path);
			if (!target.empty()) {
				memoFilterTagSetPath(tag, target);
				int resizeWidth = 0, resizeHeight = 0, error = 0;
				float ratio = 1.0f;
				if (MemoUtil::getInsertImageSize(target.c_str(), &resizeWidth, &resizeHeight, &error, &ratio)) {
					__resizePath = target;
					__resizeWidth = resizeWidth;
					__resizeHeight = resizeHeight;
					__resizeRatio = ratio;
					__startResizeWorker(target, false);
				}
			}
		}
		text.replace(pos, end - pos, tag);
		pos += tag.size();
	}
}

// Step 10 with a queue: the text waits in __pendingText until the last worker has ended.
void MemoBoxItem::__queueResizeWorkers(const std::vector<__ResizeRequest> &requests)
{
	if (__listener)
		__listener->onImagePopupRequested(true);
	// Counted before any worker starts, so that a worker that ends at once cannot find the count at 0.
	__pendingThreads += static_cast<int>(requests.size());
	for (const __ResizeRequest &request : requests) {
		__resizePath = request.target;
		__resizeWidth = request.width;
		__resizeHeight = request.height;
		__resizeRatio = request.ratio;
		__startResizeWorker(request.source, true);
	}
}

MemoBoxItem::__ResizeJob *MemoBoxItem::__startResizeWorker(const std::string &source, bool insertsPendingText)
{
	__ResizeJob *job = new __ResizeJob{this,           source,        __resizePath,       __resizeWidth,
	                                   __resizeHeight, __resizeRatio, insertsPendingText, nullptr};
	__jobs.push_back(job);
	Ecore_Thread *thread = ecore_thread_run(__resizeWorkerCb, __resizeWorkerEndCb, __resizeWorkerCancelCb, job);
	// A failed start has already run the cancel callback, which freed the job.
	if (thread) {
		job->thread = thread;
		__threadHandle = thread;
	}
	return thread ? job : nullptr;
}

void MemoBoxItem::__forgetResizeJob(__ResizeJob *job)
{
	__jobs.erase(std::remove(__jobs.begin(), __jobs.end(), job), __jobs.end());
	if (job->thread == __threadHandle)
		__threadHandle = nullptr;
}

void MemoBoxItem::__detachResizeJobs()
{
	for (__ResizeJob *job : __jobs)
		job->item = nullptr;
	bool lastRunning = false;
	for (__ResizeJob *job : __jobs)
		lastRunning = lastRunning || (job->thread && job->thread == __threadHandle);
	__jobs.clear();
	if (lastRunning)
		ecore_thread_cancel(__threadHandle);
	__threadHandle = nullptr;
}

// Worker: reads the source and replaces the job's file with the shrunk picture; touches nothing else. JPEG
// and PNG pictures are decoded, scaled and encoded on this thread; other formats, and a PNG name over other
// content, are drawn by the canvas on the main loop while the worker waits. When shrinking fails, a target
// that does not exist yet gets a plain copy of the source.
void MemoBoxItem::__resizeWorkerCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	__ResizeJob *job = static_cast<__ResizeJob *>(data);
	const std::string work = workFileFor(job->path);
	if (isJpeg(job->path))
		MemoUtil::resizeImageJpg(job->source.c_str(), work.c_str(), job->width, job->height, job->ratio);
	else if (!isPng(job->path) || !MemoUtil::resizeImagePng(job->source.c_str(), work.c_str(), job->width, job->height))
		MemoUtil::resizeImage(job->source.c_str(), work.c_str(), job->width, job->height, 2);
	if (ecore_file_exists(work.c_str())) {
		if (rename(work.c_str(), job->path.c_str()) != 0) {
			MEMO_LOGE("Can not replace %s", job->path.c_str());
			unlink(work.c_str());
		}
	}
	if (!ecore_file_exists(job->path.c_str()) && job->source != job->path && !copyFile(job->source, job->path))
		MEMO_LOGE("Copy failed: %s", job->source.c_str());
}

void MemoBoxItem::__resizeWorkerEndCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	__ResizeJob *job = static_cast<__ResizeJob *>(data);
	MemoBoxItem *self = job->item;
	const bool insertsPendingText = job->insertsPendingText;
	if (self)
		self->__forgetResizeJob(job);
	delete job;
	if (!self || !insertsPendingText)
		return;

	if (--self->__pendingThreads > 0)
		return;
	self->__pendingThreads = 0;
	if (self->__listener)
		self->__listener->onImagePopupRequested(false);
	const std::string text = self->__pendingText;
	self->__pendingText.clear();
	if (self->__entryObj)
		elm_entry_entry_insert(self->__entryObj, text.c_str());
}

void MemoBoxItem::__resizeWorkerCancelCb(void *data, Ecore_Thread *thread)
{
	// A cancelled or failed worker ends the wait as well: the picture simply stays as large as it was.
	__resizeWorkerEndCb(data, thread);
}
