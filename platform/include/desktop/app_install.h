#ifndef __DESKTOP_APP_INSTALL_H__
#define __DESKTOP_APP_INSTALL_H__

/* Desktop-only: where an installed tree keeps the files of the platform and the view framework. An
   installed program finds them beside itself, under "<its folder>/../share/", wherever the tree was
   installed; a program run from the build finds none there and uses the build's own. */

#ifdef __cplusplus
extern "C" {
#endif

/* "<folder of the running program>/../share/<sub>" (malloc'ed) when it exists, else NULL. */
char *desktop_app_install_path_get(const char *sub);

#ifdef __cplusplus
}
#endif

#endif
