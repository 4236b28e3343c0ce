#ifndef __UXT_H__
#define __UXT_H__

#include <uxt_error.h>
#include <uxt_theme.h>
#include <uxt_edit_field.h>
#include <uxt_entry.h>
#include <uxt_scroller.h>
#include <uxt_util.h>

#endif
