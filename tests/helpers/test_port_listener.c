/* Listens on a message port as the app of TIZEN_APP_ID and prints each message it gets as
   "<sender> <key>=<value> ..." (string values), one line each. Ends after <count> messages or 10 s.
   usage: test_port_listener <port> <count> */
#include <Ecore.h>
#include <message_port.h>

#include <stdio.h>
#include <stdlib.h>

static int remaining;

static void print_cb(const char *key, const int type, const bundle_keyval_t *kv, void *data)
{
	(void)type;
	(void)data;
	void *value = NULL;
	size_t size = 0;
	bundle_keyval_get_basic_val((bundle_keyval_t *)kv, &value, &size);
	printf(" %s=%s", key, value ? (const char *)value : "");
}

static void message_cb(int port_id, const char *remote_app_id, const char *remote_port, bool trusted, bundle *message,
                       void *data)
{
	(void)port_id;
	(void)remote_port;
	(void)trusted;
	(void)data;
	printf("%s", remote_app_id);
	bundle_foreach(message, print_cb, NULL);
	printf("\n");
	fflush(stdout);
	if (--remaining <= 0)
		ecore_main_loop_quit();
}

static Eina_Bool timeout_cb(void *data)
{
	(void)data;
	ecore_main_loop_quit();
	return ECORE_CALLBACK_CANCEL;
}

int main(int argc, char **argv)
{
	if (argc != 3)
		return 2;
	ecore_init();
	remaining = atoi(argv[2]);
	if (message_port_register_local_port(argv[1], message_cb, NULL) <= 0)
		return 1;
	ecore_timer_add(10.0, timeout_cb, NULL);
	ecore_main_loop_begin();
	ecore_shutdown();
	return remaining > 0;
}
