/* Localised date-time texts: the locale's best pattern for the requested fields through ICU, or a fixed
   strftime pattern when the platform is built without ICU. */
#include <uxt_util.h>

#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#ifdef TIZEN_PLATFORM_HAVE_ICU
#include <unicode/udat.h>
#include <unicode/udatpg.h>
#include <unicode/ustring.h>
#endif

#define FIELD_MASK 0xBF /* every field bit but 12H */

/* "ko_KR.UTF-8@euro" -> "ko_KR"; empty -> "en_US". */
static void __localeName(const char *locale, char *out, size_t size)
{
	if (!locale || !*locale || !strcmp(locale, "C") || !strcmp(locale, "POSIX"))
		locale = "en_US";
	snprintf(out, size, "%s", locale);
	out[strcspn(out, ".@")] = '\0';
}

#ifdef TIZEN_PLATFORM_HAVE_ICU
static void __skeleton(int format, char *out, size_t size)
{
	snprintf(out, size, "%s%s%s%s%s%s%s", (format & UXT_UTIL_DATE_TIME_FORMAT_YEAR) ? "y" : "",
	         (format & UXT_UTIL_DATE_TIME_FORMAT_MONTH) ? "MMM" : "",
	         (format & UXT_UTIL_DATE_TIME_FORMAT_DAY) ? "d" : "",
	         (format & UXT_UTIL_DATE_TIME_FORMAT_WEEKDAY) ? "EEE" : "",
	         (format & UXT_UTIL_DATE_TIME_FORMAT_HOUR) ? ((format & UXT_UTIL_DATE_TIME_FORMAT_12H) ? "h" : "H") : "",
	         (format & UXT_UTIL_DATE_TIME_FORMAT_MINUTE) ? "mm" : "",
	         (format & UXT_UTIL_DATE_TIME_FORMAT_SECOND) ? "ss" : "");
}

static char *__formatIcu(int format, const char *locale, const struct tm *time)
{
	char skeletonText[32];
	__skeleton(format, skeletonText, sizeof(skeletonText));
	UChar skeleton[32];
	u_uastrcpy(skeleton, skeletonText);

	UErrorCode status = U_ZERO_ERROR;
	UDateTimePatternGenerator *generator = udatpg_open(locale, &status);
	UChar pattern[128];
	int32_t patternLen = 0;
	if (U_SUCCESS(status))
		patternLen = udatpg_getBestPattern(generator, skeleton, -1, pattern, 128, &status);
	udatpg_close(generator);
	if (U_FAILURE(status)) {
		LOGE("no pattern for %s in %s: %s", skeletonText, locale, u_errorName(status));
		return NULL;
	}

	UDateFormat *formatter = udat_open(UDAT_PATTERN, UDAT_PATTERN, locale, NULL, -1, pattern, patternLen, &status);
	struct tm copy = *time;
	UDate date = (UDate)mktime(&copy) * 1000.0;
	UChar text[256];
	int32_t textLen = 0;
	if (U_SUCCESS(status))
		textLen = udat_format(formatter, date, text, 256, NULL, &status);
	udat_close(formatter);
	if (U_FAILURE(status)) {
		LOGE("cannot format the date in %s: %s", locale, u_errorName(status));
		return NULL;
	}

	char utf8[1024];
	int32_t utf8Len = 0;
	u_strToUTF8(utf8, sizeof(utf8), &utf8Len, text, textLen, &status);
	if (U_FAILURE(status)) {
		LOGE("cannot convert the date text: %s", u_errorName(status));
		return NULL;
	}
	return strdup(utf8);
}
#endif

static char *__formatStrftime(int format, const struct tm *time)
{
	char pattern[64] = "";
	if (format & UXT_UTIL_DATE_TIME_FORMAT_WEEKDAY)
		strcat(pattern, "%a ");
	if (format & UXT_UTIL_DATE_TIME_FORMAT_MONTH)
		strcat(pattern, "%b ");
	if (format & UXT_UTIL_DATE_TIME_FORMAT_DAY)
		strcat(pattern, "%d ");
	if (format & UXT_UTIL_DATE_TIME_FORMAT_YEAR)
		strcat(pattern, "%Y ");
	if (format & UXT_UTIL_DATE_TIME_FORMAT_HOUR)
		strcat(pattern, (format & UXT_UTIL_DATE_TIME_FORMAT_12H) ? "%I" : "%H");
	if (format & UXT_UTIL_DATE_TIME_FORMAT_MINUTE)
		strcat(pattern, ":%M");
	if (format & UXT_UTIL_DATE_TIME_FORMAT_SECOND)
		strcat(pattern, ":%S");
	if ((format & UXT_UTIL_DATE_TIME_FORMAT_HOUR) && (format & UXT_UTIL_DATE_TIME_FORMAT_12H))
		strcat(pattern, " %p");
	char text[128];
	size_t len = strftime(text, sizeof(text), pattern, time);
	while (len > 0 && text[len - 1] == ' ')
		text[--len] = '\0';
	return strdup(text);
}

char *uxt_util_get_date_time_text_by_locale(int format, const char *locale, const struct tm *time)
{
	if (!time || !(format & FIELD_MASK)) {
		LOGE("invalid parameter: format 0x%x, time %p", (unsigned)format, (const void *)time);
		return NULL;
	}
	char name[64];
	__localeName(locale, name, sizeof(name));
#ifdef TIZEN_PLATFORM_HAVE_ICU
	char *text = __formatIcu(format, name, time);
	if (text)
		return text;
#endif
	return __formatStrftime(format, time);
}
