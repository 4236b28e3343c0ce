# cmake --install [--prefix <prefix>]: a tree that runs wherever it is installed. The app root
# <prefix>/lib/com.veltron.memo holds the programs, the manifest, the resources and, under share/, the launch
# registry entry and the files of the platform layer and the view framework, which each program finds beside
# itself. <prefix>/bin links the programs onto the PATH; the desktop entry and the icon go where desktops look.
# The app keeps its data under the user's data folder ($XDG_DATA_HOME/com.veltron.memo/).
set(MEMO_APP_ID com.veltron.memo)
set(MEMO_INSTALL_ROOT lib/${MEMO_APP_ID})

install(TARGETS memo app_launcher vconftool RUNTIME DESTINATION ${MEMO_INSTALL_ROOT}/bin)
install(PROGRAMS ${PROJECT_SOURCE_DIR}/res/desktop/memo-open DESTINATION ${MEMO_INSTALL_ROOT}/bin)
install(FILES ${PROJECT_SOURCE_DIR}/res/tizen-manifest.xml DESTINATION ${MEMO_INSTALL_ROOT})
install(FILES ${PROJECT_SOURCE_DIR}/res/icon/memo.png DESTINATION ${MEMO_INSTALL_ROOT}/shared/res)
install(DIRECTORY ${MEMO_APP_ROOT}/res DESTINATION ${MEMO_INSTALL_ROOT})
install(DIRECTORY ${PROJECT_BINARY_DIR}/platform-data/ DESTINATION ${MEMO_INSTALL_ROOT}/share/tizen-platform/data)
install(FILES ${PROJECT_BINARY_DIR}/app-assist/app-assist.edj DESTINATION ${MEMO_INSTALL_ROOT}/share/app-assist)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/res/icons/hicolor DESTINATION share/icons)

# The account confirmation that a forgotten PIN needs, in a root of its own, with its PAM service file beside it.
set(MEMO_ACCOUNT_ROOT ${MEMO_INSTALL_ROOT}/companions/veltronaccount)
install(TARGETS companion-veltronaccount RUNTIME DESTINATION ${MEMO_ACCOUNT_ROOT}/bin)
install(FILES ${PROJECT_SOURCE_DIR}/companions/veltronaccount/tizen-manifest.xml DESTINATION ${MEMO_ACCOUNT_ROOT})
install(FILES ${PROJECT_SOURCE_DIR}/companions/icons/veltronaccount.png DESTINATION ${MEMO_ACCOUNT_ROOT}/shared/res)
install(FILES ${PROJECT_SOURCE_DIR}/companions/veltronaccount/com.veltron.veltronaccount.pam
	DESTINATION ${MEMO_ACCOUNT_ROOT}/share/pam.d RENAME com.veltron.veltronaccount)
# PAM reads the system's services from here; an install without the right to write it leaves the copy above.
set(MEMO_PAM_DIR /etc/pam.d CACHE PATH "Where the install step puts the PAM service of the account confirmation")

# Files that name installed paths are written at install time, when the prefix is known.
install(CODE "
	set(MEMO_APP_ID ${MEMO_APP_ID})
	set(MEMO_INSTALL_ROOT ${MEMO_INSTALL_ROOT})
	set(MEMO_SOURCE_DIR \"${PROJECT_SOURCE_DIR}\")
	set(MEMO_STAGE_DIR \"${PROJECT_BINARY_DIR}/install-stage\")
	set(MEMO_BUILD_ENTRY \"${TIZEN_APPS_DIR_DEFAULT}/${MEMO_APP_ID}.ini\")
	set(MEMO_ACCOUNT_ROOT ${MEMO_ACCOUNT_ROOT})
	set(MEMO_ACCOUNT_ENTRY \"${TIZEN_APPS_DIR_DEFAULT}/com.veltron.veltronaccount.ini\")
	set(MEMO_PAM_DIR \"${MEMO_PAM_DIR}\")
")
install(SCRIPT ${PROJECT_SOURCE_DIR}/cmake/InstallGenerated.cmake)
