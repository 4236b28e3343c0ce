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

# Files that name installed paths are written at install time, when the prefix is known.
install(CODE "
	set(MEMO_APP_ID ${MEMO_APP_ID})
	set(MEMO_INSTALL_ROOT ${MEMO_INSTALL_ROOT})
	set(MEMO_SOURCE_DIR \"${PROJECT_SOURCE_DIR}\")
	set(MEMO_STAGE_DIR \"${PROJECT_BINARY_DIR}/install-stage\")
	set(MEMO_BUILD_ENTRY \"${TIZEN_APPS_DIR_DEFAULT}/${MEMO_APP_ID}.ini\")
")
install(SCRIPT ${PROJECT_SOURCE_DIR}/cmake/InstallGenerated.cmake)
