// A share request's content for the new memo on top: the subject becomes its title, text or a text file
// its body, a picture goes in as a picture.
#include "MemoApp.h"

#include <cstdlib>
#include <cstring>
#include <fstream>
#include <string>

#include <Elementary.h>
#include <app_control.h>

#include <WContentViewController.h>
#include <WUiTimer.h>

#include "MemoLog.h"
#include "Util/MemoUtil.h"
#include "View/MemoEditView.h"

using app_assist::WUiTimer;

static const char *const FILE_URI_PREFIX = "file://";
// The body of a shared memo holds at most this many characters.
static const int SHARED_TEXT_MAX_CHARS = 4096;
// A text file is read no further than this: what follows could never reach the body.
static const size_t SHARED_FILE_MAX_BYTES = 1024 * 1024;
static const char *const IMAGE_EXTENSIONS[] = {".jpg", ".png", ".jpeg", ".gif", ".bmp", ".tif", ".tiff"};

// The shared path, or empty for a URI that is no file URI (logged).
static std::string pathOfUri(const char *uri)
{
	const size_t prefixLength = strlen(FILE_URI_PREFIX);
	if (!uri || strlen(uri) < prefixLength || strncmp(uri, FILE_URI_PREFIX, prefixLength)) {
		MEMO_LOGE("not a file URI: %s", uri ? uri : "(none)");
		return std::string();
	}
	return std::string(uri + prefixLength);
}

static bool isImagePath(const std::string &path, const char *majorType)
{
	if (majorType && !strcmp(majorType, "image"))
		return true;
	for (const char *extension : IMAGE_EXTENSIONS)
		if (eina_str_has_extension(path.c_str(), extension))
			return true;
	return false;
}

// The file's lines joined by "\n", with none after the last line; null when it cannot be opened (logged).
static char *readTextFileN(const std::string &path)
{
	std::ifstream file(path);
	if (!file.is_open()) {
		MEMO_LOGE("File open failed.");
		return nullptr;
	}
	std::string text;
	for (std::string line; text.size() < SHARED_FILE_MAX_BYTES && std::getline(file, line);) {
		text += line;
		if (!file.eof())
			text += "\n";
	}
	return strdup(text.c_str());
}

// Shared text goes into the entry as markup, where "&" begins an entity: each one is written "&amp;".
static std::string escapeAmpersands(const char *text)
{
	std::string out;
	for (const char *c = text; *c; ++c) {
		if (*c == '&')
			out += "&amp;";
		else
			out += *c;
	}
	return out;
}

// Text over the limit is cut to as many bytes as the limit has characters, at a character's start.
static void cutToLimit(std::string &markup)
{
	char *plain = elm_entry_markup_to_utf8(markup.c_str());
	const int count = plain ? evas_string_char_len_get(plain) : 0;
	free(plain);
	if (count <= SHARED_TEXT_MAX_CHARS)
		return;
	size_t end = SHARED_TEXT_MAX_CHARS;
	while (end > 0 && (static_cast<unsigned char>(markup[end]) & 0xC0) == 0x80)
		--end;
	markup.resize(end);
}

// The text of a request's extra data, made fit for storing; null when absent.
static char *storableExtraN(app_control_s *request, const char *key)
{
	char *value = nullptr;
	if (app_control_get_extra_data(request, key, &value) != APP_CONTROL_ERROR_NONE) {
		free(value);
		return nullptr;
	}
	char *storable = MemoUtil::stripControlCharsN(value);
	free(value);
	return storable;
}

void MemoApp::__fillSharedMemo(app_control_s *request, const char *operation)
{
	char *mime = nullptr;
	app_control_get_mime(request, &mime);
	const char *majorType = mime ? strtok(mime, "/") : nullptr;

	char *text = nullptr;
	char *subject = nullptr;
	std::string imagePath;
	if (operation && !strcmp(operation, APP_CONTROL_OPERATION_SHARE)) {
		char *uri = nullptr;
		app_control_get_uri(request, &uri);
		std::string path = pathOfUri(uri);
		free(uri);
		if (!path.empty() && isImagePath(path, majorType)) {
			imagePath = path;
		} else if (!path.empty()) {
			char *raw = readTextFileN(path);
			text = MemoUtil::stripControlCharsN(raw);
			free(raw);
		}
	} else {
		text = storableExtraN(request, APP_CONTROL_DATA_TEXT);
		subject = storableExtraN(request, APP_CONTROL_DATA_SUBJECT);
	}

	MemoEditView *view = dynamic_cast<MemoEditView *>(__getTopView());
	if (view && subject)
		view->insertTextToTitle(escapeAmpersands(subject).c_str());
	if (view && text) {
		std::string body = escapeAmpersands(text);
		cutToLimit(body);
		// The body takes the text once the page has been laid out; the idler dies with the page.
		WUiTimer::addIdler(
		    [view, body](void *) {
			    view->insertTextToBody(body.c_str());
			    MEMO_LOGD("shared text in the body");
			    return false;
		    },
		    nullptr, view->getEvasObj());
	}
	if (view && !imagePath.empty())
		view->insertImage(imagePath.c_str());
	free(subject);
	free(text);
	free(mime);
}
