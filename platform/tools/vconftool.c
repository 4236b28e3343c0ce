/* vconftool: reads and writes vconf keys from the shell, e.g. to drive device state on the desktop.
     vconftool get <key>                              prints "<key>, value = <value> (<type>)"
     vconftool set -t <int|bool|double|string> <key> <value> [-f] [-i] [-u uid] [-g gid] [-s label]
     vconftool unset <key>
   Options may come before or after the command and its operands. Exit status: 0 done, 1 key missing or
   store failure, 2 bad arguments. */
#define _GNU_SOURCE
#include <errno.h>
#include <limits.h>
#include <stdbool.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <vconf.h>

#define EXIT_STORE 1
#define EXIT_USAGE 2

typedef struct {
	const char *type;
	const char *operands[4];
	int count;
} args_t;

static int __usage(const char *problem)
{
	if (problem)
		fprintf(stderr, "vconftool: %s\n", problem);
	fprintf(stderr, "usage: vconftool get <key>\n"
	                "       vconftool set -t <int|bool|double|string> <key> <value> [-f]\n"
	                "       vconftool unset <key>\n"
	                "keys start with db/, file/ or memory/\n");
	return EXIT_USAGE;
}

static bool __isNumber(const char *arg)
{
	return arg[0] == '-' && (arg[1] >= '0' && arg[1] <= '9');
}

/* Splits options from operands; false (with a message) on a bad option. */
static bool __parseArgs(int argc, char **argv, args_t *args)
{
	bool optionsDone = false;
	for (int i = 1; i < argc; i++) {
		const char *arg = argv[i];
		if (optionsDone || arg[0] != '-' || !arg[1] || __isNumber(arg)) {
			if (args->count == (int)(sizeof(args->operands) / sizeof(args->operands[0]))) {
				fprintf(stderr, "vconftool: too many arguments\n");
				return false;
			}
			args->operands[args->count++] = arg;
		} else if (!strcmp(arg, "--")) {
			optionsDone = true;
		} else if (!strcmp(arg, "-t") || !strcmp(arg, "--type")) {
			if (++i >= argc) {
				fprintf(stderr, "vconftool: %s needs a type\n", arg);
				return false;
			}
			args->type = argv[i];
		} else if (!strcmp(arg, "-u") || !strcmp(arg, "-g") || !strcmp(arg, "-s") || !strcmp(arg, "--smack")) {
			/* Owner and security label mean nothing on the desktop store. */
			if (++i >= argc) {
				fprintf(stderr, "vconftool: %s needs a value\n", arg);
				return false;
			}
		} else if (strcmp(arg, "-f") && strcmp(arg, "--force") && strcmp(arg, "-i") && strcmp(arg, "--install")) {
			fprintf(stderr, "vconftool: unknown option %s\n", arg);
			return false;
		}
	}
	return true;
}

static int __get(const char *key)
{
	int type = VCONF_TYPE_NONE;
	if (vconf_get_type(key, &type) != VCONF_OK) {
		fprintf(stderr, "vconftool: %s: no such key\n", key);
		return EXIT_STORE;
	}
	int i = 0;
	double d = 0;
	char *s = NULL;
	switch (type) {
	case VCONF_TYPE_INT:
		if (vconf_get_int(key, &i) != VCONF_OK)
			break;
		printf("%s, value = %d (int)\n", key, i);
		return 0;
	case VCONF_TYPE_BOOL:
		if (vconf_get_bool(key, &i) != VCONF_OK)
			break;
		printf("%s, value = %d (bool)\n", key, i);
		return 0;
	case VCONF_TYPE_DOUBLE:
		if (vconf_get_dbl(key, &d) != VCONF_OK)
			break;
		printf("%s, value = %f (double)\n", key, d);
		return 0;
	default:
		s = vconf_get_str(key);
		if (!s)
			break;
		printf("%s, value = %s (string)\n", key, s);
		free(s);
		return 0;
	}
	fprintf(stderr, "vconftool: %s: cannot read the value\n", key);
	return EXIT_STORE;
}

static bool __parseInt(const char *text, int *out)
{
	char *end = NULL;
	errno = 0;
	long v = strtol(text, &end, 0);
	if (errno || end == text || *end || v < INT_MIN || v > INT_MAX)
		return false;
	*out = (int)v;
	return true;
}

static int __set(const char *type, const char *key, const char *value)
{
	int rc = VCONF_ERROR;
	int i = 0;
	if (!strcmp(type, "int")) {
		if (!__parseInt(value, &i))
			return __usage("the value is not an int");
		rc = vconf_set_int(key, i);
	} else if (!strcmp(type, "bool")) {
		if (!strcmp(value, "true"))
			i = 1;
		else if (!strcmp(value, "false"))
			i = 0;
		else if (!__parseInt(value, &i) || (i != 0 && i != 1))
			return __usage("the value is not a bool (0, 1, true, false)");
		rc = vconf_set_bool(key, i);
	} else if (!strcmp(type, "double")) {
		char *end = NULL;
		double d = strtod(value, &end);
		if (end == value || *end)
			return __usage("the value is not a double");
		rc = vconf_set_dbl(key, d);
	} else if (!strcmp(type, "string")) {
		rc = vconf_set_str(key, value);
	} else {
		return __usage("the type must be int, bool, double or string");
	}
	if (rc != VCONF_OK) {
		fprintf(stderr, "vconftool: cannot set %s\n", key);
		return EXIT_STORE;
	}
	return 0;
}

int main(int argc, char **argv)
{
	args_t args = {0};
	if (!__parseArgs(argc, argv, &args))
		return __usage(NULL);
	if (args.count == 0)
		return __usage("no command");
	const char *command = args.operands[0];
	const char *key = args.count > 1 ? args.operands[1] : NULL;
	if (key && strncmp(key, "db/", 3) && strncmp(key, "file/", 5) && strncmp(key, "memory/", 7))
		return __usage("keys start with db/, file/ or memory/");
	if (!strcmp(command, "get") && args.count == 2)
		return __get(key);
	if (!strcmp(command, "unset") && args.count == 2) {
		if (vconf_unset(key) != VCONF_OK) {
			fprintf(stderr, "vconftool: %s: no such key\n", key);
			return EXIT_STORE;
		}
		return 0;
	}
	if (!strcmp(command, "set") && args.count == 3) {
		if (!args.type)
			return __usage("set needs -t <type>");
		return __set(args.type, key, args.operands[2]);
	}
	return __usage("bad command or wrong number of arguments");
}
