#ifndef __TIZEN_APPFW_APP_I18N_H__
#define __TIZEN_APPFW_APP_I18N_H__

#ifdef __cplusplus
extern "C" {
#endif

/* The translation of message in the device language, from the package's catalogue
   "<resource path>locale/<lang>/LC_MESSAGES/<app id>.mo"; message itself when there is none, NULL for a
   null message. The result is not to be freed. It follows language changes of the device (applied by
   the application layer through LANGUAGE and setlocale), even where no matching system locale is
   installed. */
char *i18n_get_text(const char *message);

#define _(msg) i18n_get_text(msg)

#ifdef __cplusplus
}
#endif

#endif
