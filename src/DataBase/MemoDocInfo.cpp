#include "DataBase/MemoDocInfo.h"

#include <cstdlib>
#include <cstring>

#include "MemoLog.h"
#include "MemoRecordField.h"
#include "Util/MemoUtil.h"

// One default colour text for every record.
static const MemoText &__defaultColor()
{
	static const MemoText color(MEMO_DEFAULT_BG_COLOR);
	return color;
}

MemoDocInfo::MemoDocInfo()
    : __isDirty(1), __isDeleted(0), __sync1(0), __isNeedUpsync(1), __createdAt(1), __lastModifiedAt(1), __isFavorite(0),
      __isHidden(0), __isQuick(0), __fileCount(0), __bgRed(228), __bgGreen(235), __bgBlue(235), __bgAlpha(255),
      __bgColor(__defaultColor()), __changed(0)
{
	(void)__changed;
}

MemoDocInfo::~MemoDocInfo() {}

MemoDocInfo::MemoDocInfo(const MemoDocInfo &other)
{
	*this = other;
}

MemoDocInfo &MemoDocInfo::operator=(const MemoDocInfo &other)
{
	if (this == &other)
		return *this;
	__texts = other.__texts;
	__memoUUID = other.__memoUUID;
	__isDirty = other.__isDirty;
	__isDeleted = other.__isDeleted;
	__accountType = other.__accountType;
	__accountName = other.__accountName;
	__sync1 = other.__sync1;
	__sync2 = other.__sync2;
	__isNeedUpsync = other.__isNeedUpsync;
	__createdAt = other.__createdAt;
	__lastModifiedAt = other.__lastModifiedAt;
	__categoryUUID = other.__categoryUUID;
	__title = other.__title;
	__content = other.__content;
	__androidXmlContent = other.__androidXmlContent;
	__tizenXmlContent = other.__tizenXmlContent;
	__displayContent = other.__displayContent;
	__vrfileUUID = other.__vrfileUUID;
	__strippedContent = other.__strippedContent;
	__data = other.__data;
	__phoneNum = other.__phoneNum;
	__isFavorite = other.__isFavorite;
	__isHidden = other.__isHidden;
	__isQuick = other.__isQuick;
	__fileCount = other.__fileCount;
	__files.reset();
	if (other.__files) {
		MemoFileInfo *files = getFiles();
		for (int i = 0; i < MEMO_MAX_FILE_COUNT; ++i)
			files[i] = other.__files[i];
	}
	__bgRed = other.__bgRed;
	__bgGreen = other.__bgGreen;
	__bgBlue = other.__bgBlue;
	__bgAlpha = other.__bgAlpha;
	__bgColor = other.__bgColor;
	__changed = other.__changed;
	return *this;
}

MemoFileInfo *MemoDocInfo::getFiles()
{
	if (!__files)
		__files.reset(new MemoFileInfo[MEMO_MAX_FILE_COUNT]);
	return __files.get();
}

const MemoFileInfo *MemoDocInfo::getFiles() const
{
	if (!__files)
		__files.reset(new MemoFileInfo[MEMO_MAX_FILE_COUNT]);
	return __files.get();
}

bool MemoDocInfo::setMemoUUID(const MemoText &uuid)
{
	if (uuid.isNull()) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	__memoUUID = uuid;
	return false;
}

bool MemoDocInfo::setIsDirty(int isDirty)
{
	MEMO_RECORD_SET(memoRecordIsFlag(isDirty), __isDirty, isDirty, "isDirty is Wrong Value");
}

bool MemoDocInfo::setIsDeleted(int isDeleted)
{
	MEMO_RECORD_SET(memoRecordIsFlag(isDeleted), __isDeleted, isDeleted, "isDeleted is Wrong Value");
}

bool MemoDocInfo::setAccountType(const MemoText &accountType)
{
	MEMO_RECORD_SET(!accountType.isNull(), __accountType, accountType, "accountType is NULL");
}

bool MemoDocInfo::setAccountName(const MemoText &accountName)
{
	MEMO_RECORD_SET(!accountName.isNull(), __accountName, accountName, "accountName is NULL");
}

bool MemoDocInfo::setSync1(unsigned long long sync1)
{
	__sync1 = sync1;
	return true;
}

bool MemoDocInfo::setSync2(const MemoText &sync2)
{
	MEMO_RECORD_SET(!sync2.isNull(), __sync2, sync2, "sync2 is NULL");
}

bool MemoDocInfo::setIsNeedUpsync(int isNeedUpsync)
{
	MEMO_RECORD_SET(memoRecordIsFlag(isNeedUpsync), __isNeedUpsync, isNeedUpsync, "isNeedUpsync is Wrong Value");
}

bool MemoDocInfo::setCreatedAt(unsigned long long createdAt)
{
	__createdAt = createdAt;
	return true;
}

bool MemoDocInfo::setLastModifiedAt(unsigned long long lastModifiedAt)
{
	__lastModifiedAt = lastModifiedAt;
	return true;
}

bool MemoDocInfo::setCategoryUUID(const MemoText &categoryUUID)
{
	MEMO_RECORD_SET(!categoryUUID.isNull(), __categoryUUID, categoryUUID, "categoryUUID is NULL");
}

bool MemoDocInfo::setTitle(const MemoText &title)
{
	MEMO_RECORD_SET(!title.isNull(), __title, title, "title is NULL");
}

bool MemoDocInfo::setContent(const MemoText &content)
{
	MEMO_RECORD_SET(!content.isNull(), __content, content, "content is NULL");
}

bool MemoDocInfo::setTizenXmlContent(const MemoText &tizenXmlContent)
{
	MEMO_RECORD_SET(!tizenXmlContent.isNull(), __tizenXmlContent, tizenXmlContent, "tizenXmlContent is NULL");
}

bool MemoDocInfo::setAndroidXmlContent(const MemoText &androidXmlContent)
{
	MEMO_RECORD_SET(!androidXmlContent.isNull(), __androidXmlContent, androidXmlContent, "androidXmlContent is NULL");
}

bool MemoDocInfo::setDisplayContent(const MemoText &displayContent)
{
	MEMO_RECORD_SET(!displayContent.isNull(), __displayContent, displayContent, "display_Content is NULL");
}

bool MemoDocInfo::setVrfileUUID(const MemoText &vrfileUUID)
{
	MEMO_RECORD_SET(!vrfileUUID.isNull(), __vrfileUUID, vrfileUUID, "vrfileUUID is NULL");
}

bool MemoDocInfo::setStrippedContent(const MemoText &strippedContent)
{
	MEMO_RECORD_SET(!strippedContent.isNull(), __strippedContent, strippedContent, "strippedContent is NULL");
}

bool MemoDocInfo::setData(const MemoText &data)
{
	MEMO_RECORD_SET(!data.isNull(), __data, data, "data is NULL");
}

bool MemoDocInfo::setPhoneNum(const MemoText &phoneNum)
{
	// _phoneNum is NULL on most rows: no line for it.
	if (phoneNum.isNull())
		return false;
	__phoneNum = phoneNum;
	return true;
}

bool MemoDocInfo::setIsFavorite(int isFavorite)
{
	__isFavorite = isFavorite;
	return true;
}

bool MemoDocInfo::setIsHidden(int isHidden)
{
	__isHidden = isHidden;
	return true;
}

bool MemoDocInfo::setIsQuick(int isQuick)
{
	__isQuick = isQuick;
	return true;
}

bool MemoDocInfo::setFileCount(int fileCount)
{
	MEMO_RECORD_SET(fileCount >= 0, __fileCount, fileCount, "fileCount is Wrong Value");
}

// The channels of a colour text of plain numbers (one to nine digits each), as std::stoi reads them; false for
// any other text, which the general reading below takes.
static bool __readPlainColor(const char *text, int *const channels[4], bool *complete)
{
	if (text[strspn(text, "0123456789;")] != '\0')
		return false;
	for (int i = 0; i < 4; ++i) {
		const char *end = strchr(text, ';');
		if (!end) {
			*complete = false;
			return true;
		}
		if (end == text || end - text > 9)
			return false;
		int value = 0;
		for (; text < end; ++text)
			value = value * 10 + (*text - '0');
		*channels[i] = value;
		text = end + 1;
	}
	*complete = true;
	return true;
}

bool MemoDocInfo::setBgColor(const MemoText &bgColor)
{
	__bgColor = bgColor.isNull() ? MemoText("") : bgColor;
	// A 16-character text ("rrr;ggg;bbb;aaa;") is trusted as it stands; anything else
	// must at least have its four separators.
	if (__bgColor.length() != 16) {
		size_t separators = 0;
		for (const char *c = __bgColor.c_str(); *c; ++c)
			if (*c == ';')
				++separators;
		if (__bgColor.empty() || separators != 4)
			__bgColor = __defaultColor();
	}

	int *const channels[] = {&__bgRed, &__bgGreen, &__bgBlue, &__bgAlpha};
	bool complete = false;
	if (__readPlainColor(__bgColor.c_str(), channels, &complete))
		return complete;
	const std::string color = __bgColor.c_str();
	size_t start = 0;
	for (int *channel : channels) {
		size_t end = color.find(';', start);
		if (end == std::string::npos)
			return false;
		*channel = std::stoi(color.substr(start, end - start));
		start = end + 1;
	}
	return true;
}

bool MemoDocInfo::setBgColorRgba(int red, int green, int blue, int alpha)
{
	__bgRed = red;
	__bgGreen = green;
	__bgBlue = blue;
	__bgAlpha = alpha;
	__bgColor = MemoText((std::to_string(red) + ";" + std::to_string(green) + ";" + std::to_string(blue) + ";" +
	                      std::to_string(alpha) + ";")
	                         .c_str());
	return true;
}

void MemoDocInfo::copyFileInfos(const MemoFileInfo *source)
{
	if (!source)
		return;
	MemoFileInfo *files = getFiles();
	for (int i = 0; i < __fileCount && i < MEMO_MAX_FILE_COUNT; ++i) {
		const MemoFileInfo &from = source[i];
		MemoFileInfo &to = files[i];
		to.setFileUUID(from.getFileUUID());
		to.setIsDirty(from.getIsDirty());
		to.setIsDeleted(from.getIsDeleted());
		to.setAccountType(from.getAccountType());
		to.setAccountName(from.getAccountName());
		to.setSync1(from.getSync1());
		to.setSync2(from.getSync2());
		to.setIsNeedUpsync(from.getIsNeedUpsync());
		to.setMemoUUID(from.getMemoUUID());
		to.setMimeType(from.getMimeType());
		to.setDisplayName(from.getDisplayName());
		to.setSize(from.getSize());
		to.setOrientation(from.getOrientation());
		to.setData(from.getData());
		to.setPath(from.getPath());
	}
}

const char *MemoDocInfo::getMemoUUID()
{
	if (__memoUUID.empty()) {
		char *uuid = nullptr;
		if (MemoUtil::createUUIDN(&uuid)) {
			setMemoUUID(uuid);
			free(uuid);
		}
	}
	return __memoUUID.c_str();
}

void MemoDocInfo::getBgColorRgba(int *red, int *green, int *blue, int *alpha) const
{
	if (red)
		*red = __bgRed;
	if (green)
		*green = __bgGreen;
	if (blue)
		*blue = __bgBlue;
	if (alpha)
		*alpha = __bgAlpha;
}
