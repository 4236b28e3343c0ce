/* What takes the sound away from recorders and players: a call ("memory/call/state") and the
   earjack ("memory/sysman/earjack"). */
#ifndef PLATFORM_SRC_MEDIA_MEDIA_POLICY_H
#define PLATFORM_SRC_MEDIA_MEDIA_POLICY_H

#include <stdbool.h>

typedef enum {
	MEDIA_POLICY_CALL,    /* value: 1 when a call rings or is on, 0 when it is over */
	MEDIA_POLICY_EARJACK, /* value: the earjack key */
} media_policy_event_e;

typedef void (*media_policy_cb)(media_policy_event_e event, int value, void *data);

/* Registers a listener (on the main loop, in the order added); false (logged) when the keys cannot be
   watched. A listener may remove itself or others while called. */
bool media_policy_listen(media_policy_cb cb, void *data);
void media_policy_unlisten(media_policy_cb cb, void *data);

bool media_policy_in_call(void);
/* The earjack key: VCONFKEY_SYSMAN_EARJACK_*. */
int media_policy_earjack(void);

#endif
