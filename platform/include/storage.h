#ifndef __TIZEN_SYSTEM_STORAGE_H__
#define __TIZEN_SYSTEM_STORAGE_H__

#include <sys/statvfs.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	STORAGE_ERROR_NONE = TIZEN_ERROR_NONE,
	STORAGE_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	STORAGE_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	STORAGE_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NO_SUCH_DEVICE,
	STORAGE_ERROR_OPERATION_FAILED = TIZEN_ERROR_SYSTEM_CLASS | 0x12,
} storage_error_e;

typedef enum {
	STORAGE_TYPE_INTERNAL = 0,
	STORAGE_TYPE_EXTERNAL = 1,
} storage_type_e;

typedef enum {
	STORAGE_STATE_UNMOUNTABLE = -2,
	STORAGE_STATE_REMOVED = -1,
	STORAGE_STATE_MOUNTED = 0,
	STORAGE_STATE_MOUNTED_READ_ONLY = 1,
} storage_state_e;

/* Fills buf with the file system figures of the internal storage (on the desktop: the file system
   that holds the app's data folder). The vconf key "db/desktop/storage/internal_free_bytes" (int, or
   string of decimal bytes), when set, replaces the free space so that a full disk can be simulated:
   f_bsize becomes 1 and f_bavail/f_bfree the number of bytes. 0 on success, a negative
   STORAGE_ERROR_* value on failure. */
#ifndef __USE_FILE_OFFSET64
extern int storage_get_internal_memory_size(struct statvfs *buf);
#else
#define storage_get_internal_memory_size storage_get_internal_memory_size64
#endif
extern int storage_get_internal_memory_size64(struct statvfs *buf);

/* Free and total bytes of a storage; only STORAGE_TYPE_INTERNAL (id 0) exists on the desktop. */
int storage_get_available_space(int storage_id, unsigned long long *bytes);
int storage_get_total_space(int storage_id, unsigned long long *bytes);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_SYSTEM_STORAGE_H__ */
