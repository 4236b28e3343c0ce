# Run by cmake --install after the plain files: the registry entry and the desktop entry, which name the
# installed programs, and the links in <prefix>/bin. Made in a stage folder, then installed from there.
set(root "${CMAKE_INSTALL_PREFIX}/${MEMO_INSTALL_ROOT}")
file(REMOVE_RECURSE "${MEMO_STAGE_DIR}")

# The build's own entry (label, icon, operations, mime types from the manifest) with the installed paths.
file(READ "${MEMO_BUILD_ENTRY}" entry)
string(REGEX REPLACE "\nexec=[^\n]*" "\nexec=${root}/bin/memo" entry "${entry}")
string(REGEX REPLACE "\nroot=[^\n]*" "\nroot=${root}" entry "${entry}")
file(WRITE "${MEMO_STAGE_DIR}/apps/${MEMO_APP_ID}.ini" "${entry}")
file(INSTALL "${MEMO_STAGE_DIR}/apps/${MEMO_APP_ID}.ini" DESTINATION "${root}/share/tizen-platform/apps")

set(MEMO_OPEN "${root}/bin/memo-open")
configure_file("${MEMO_SOURCE_DIR}/res/desktop/${MEMO_APP_ID}.desktop.in"
	"${MEMO_STAGE_DIR}/applications/${MEMO_APP_ID}.desktop" @ONLY)
file(INSTALL "${MEMO_STAGE_DIR}/applications/${MEMO_APP_ID}.desktop"
	DESTINATION "${CMAKE_INSTALL_PREFIX}/share/applications")

file(MAKE_DIRECTORY "${MEMO_STAGE_DIR}/bin")
foreach(program memo app_launcher vconftool)
	file(CREATE_LINK "../${MEMO_INSTALL_ROOT}/bin/${program}" "${MEMO_STAGE_DIR}/bin/${program}" SYMBOLIC)
	file(INSTALL "${MEMO_STAGE_DIR}/bin/${program}" DESTINATION "${CMAKE_INSTALL_PREFIX}/bin")
endforeach()
