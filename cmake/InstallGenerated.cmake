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

# The account confirmation's entry beside it. A system-wide install (/usr, /usr/local) also puts its PAM service
# where PAM looks, when that may be written; other installs keep to the copy beside the program.
set(account_root "${CMAKE_INSTALL_PREFIX}/${MEMO_ACCOUNT_ROOT}")
file(READ "${MEMO_ACCOUNT_ENTRY}" entry)
string(REGEX REPLACE "\nexec=[^\n]*" "\nexec=${account_root}/bin/veltronaccount" entry "${entry}")
string(REGEX REPLACE "\nroot=[^\n]*" "\nroot=${account_root}" entry "${entry}")
file(WRITE "${MEMO_STAGE_DIR}/apps/com.veltron.veltronaccount.ini" "${entry}")
file(INSTALL "${MEMO_STAGE_DIR}/apps/com.veltron.veltronaccount.ini" DESTINATION "${root}/share/tizen-platform/apps")
set(pam_dir "$ENV{DESTDIR}${MEMO_PAM_DIR}")
if(CMAKE_INSTALL_PREFIX MATCHES "^/usr(/local)?/?$" AND MEMO_PAM_DIR AND IS_DIRECTORY "${pam_dir}"
	AND NOT EXISTS "${pam_dir}/com.veltron.veltronaccount")
	execute_process(COMMAND test -w "${pam_dir}" RESULT_VARIABLE pam_dir_unwritable)
	if(pam_dir_unwritable EQUAL 0)
		file(INSTALL "${account_root}/share/pam.d/com.veltron.veltronaccount" DESTINATION "${MEMO_PAM_DIR}")
	else()
		message(STATUS "No right to write ${MEMO_PAM_DIR}: the account confirmation uses the PAM service in "
			"${account_root}/share/pam.d")
	endif()
endif()

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
