/* Messages on the launch sockets: one frame format, writes that give up after a deadline, and a reader
   on the main loop that hands whole messages to its owner. */
#include "app_private.h"

#include <dlog.h>
#include <errno.h>
#include <poll.h>
#include <stdint.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <time.h>
#include <unistd.h>

#define FRAME_MAGIC 0x54415050u /* "TAPP" */
/* Far above any request (texts are cut to a few thousand characters, files go by path); a larger
   message is refused before any of it is buffered, so a hostile sender cannot make us hold more. */
#define FRAME_MAX_SIZE (8 << 20)
#define READ_CHUNK 65536

typedef struct {
	uint32_t magic;
	int32_t major;
	int32_t ref;
	int32_t response;
	uint32_t size;
} frame_header_s;

struct app_message_reader_s {
	int fd;
	Ecore_Fd_Handler *handler;
	app_message_cb callback;
	void *data;
	unsigned char *buf;
	size_t len;
	size_t cap;
	bool dispatching;
	bool deleted;
};

static double monotonic_now(void)
{
	struct timespec ts;
	clock_gettime(CLOCK_MONOTONIC, &ts);
	return ts.tv_sec + ts.tv_nsec / 1e9;
}

/* Writes all of buf unless the receiver takes nothing for the rest of the time. */
static int write_all(int fd, const void *buf, size_t size, double end)
{
	const unsigned char *p = buf;
	while (size > 0) {
		ssize_t n = send(fd, p, size, MSG_NOSIGNAL | MSG_DONTWAIT);
		if (n > 0) {
			p += n;
			size -= (size_t)n;
			continue;
		}
		if (n < 0 && errno == EINTR)
			continue;
		if (n < 0 && errno != EAGAIN && errno != EWOULDBLOCK) {
			LOGE("the receiver is gone (%s)", strerror(errno));
			return APP_CONTROL_ERROR_IO_ERROR;
		}
		double left = end - monotonic_now();
		if (left <= 0)
			return APP_CONTROL_ERROR_TIMED_OUT;
		struct pollfd pfd = {fd, POLLOUT, 0};
		int r = poll(&pfd, 1, (int)(left * 1000) + 1);
		if (r < 0 && errno != EINTR) {
			LOGE("cannot wait for the receiver (%s)", strerror(errno));
			return APP_CONTROL_ERROR_IO_ERROR;
		}
		if (r > 0 && (pfd.revents & (POLLERR | POLLHUP))) {
			LOGE("the receiver is gone");
			return APP_CONTROL_ERROR_IO_ERROR;
		}
	}
	return APP_CONTROL_ERROR_NONE;
}

int app_message_send(int fd, const app_message_s *msg, double timeout_sec)
{
	if (fd < 0 || !msg || msg->size < 0 || msg->size > FRAME_MAX_SIZE || (msg->size > 0 && !msg->data))
		return APP_CONTROL_ERROR_INVALID_PARAMETER;
	double end = monotonic_now() + timeout_sec;
	frame_header_s header = {FRAME_MAGIC, msg->major, msg->ref, msg->response, (uint32_t)msg->size};
	int ret = write_all(fd, &header, sizeof(header), end);
	if (ret == APP_CONTROL_ERROR_NONE && msg->size > 0)
		ret = write_all(fd, msg->data, (size_t)msg->size, end);
	if (ret == APP_CONTROL_ERROR_TIMED_OUT)
		LOGE("the receiver took no message for %.1f s: stopped or busy", timeout_sec);
	return ret;
}

static void reader_free(app_message_reader_s *r)
{
	if (r->handler)
		ecore_main_fd_handler_del(r->handler);
	close(r->fd);
	free(r->buf);
	free(r);
}

/* Hands every whole message in the buffer over; false once the owner let the reader go. */
static bool reader_dispatch(app_message_reader_s *r)
{
	size_t used = 0;
	bool ok = true;
	while (r->len - used >= sizeof(frame_header_s)) {
		frame_header_s header;
		memcpy(&header, r->buf + used, sizeof(header));
		if (header.magic != FRAME_MAGIC) {
			LOGE("a stream that is not made of launch messages: connection dropped");
			ok = false;
			break;
		}
		if (header.size > FRAME_MAX_SIZE) {
			LOGE("a message of %u bytes refused (at most %d): connection dropped", header.size, FRAME_MAX_SIZE);
			ok = false;
			break;
		}
		if (r->len - used - sizeof(header) < header.size)
			break;
		app_message_s msg = {header.major, header.ref, header.response, (int)header.size,
		                     r->buf + used + sizeof(header)};
		used += sizeof(header) + header.size;
		r->callback(r->data, r, &msg);
		if (r->deleted)
			return false;
	}
	memmove(r->buf, r->buf + used, r->len - used);
	r->len -= used;
	return ok;
}

/* Reads what has come; false when the connection has ended (closed, broken or not ours). */
static bool reader_fill(app_message_reader_s *r)
{
	for (;;) {
		if (r->cap - r->len < READ_CHUNK) {
			size_t cap = r->cap ? r->cap * 2 : READ_CHUNK;
			unsigned char *grown = realloc(r->buf, cap);
			if (!grown)
				return false;
			r->buf = grown;
			r->cap = cap;
		}
		ssize_t n = recv(r->fd, r->buf + r->len, r->cap - r->len, MSG_DONTWAIT);
		if (n > 0) {
			r->len += (size_t)n;
			continue;
		}
		if (n < 0 && errno == EINTR)
			continue;
		return n < 0 && (errno == EAGAIN || errno == EWOULDBLOCK);
	}
}

bool app_message_reader_read(app_message_reader_s *r)
{
	bool open = reader_fill(r);
	r->dispatching = true;
	bool go_on = reader_dispatch(r) && open;
	if (go_on && !r->deleted) {
		r->dispatching = false;
		return true;
	}
	if (!r->deleted) {
		if (r->len > 0)
			LOGE("the sender left a message unfinished");
		r->callback(r->data, r, NULL);
	}
	reader_free(r);
	return false;
}

static Eina_Bool reader_fd_cb(void *data, Ecore_Fd_Handler *handler)
{
	(void)handler;
	/* A reader that ends deletes this handler itself. */
	app_message_reader_read(data);
	return ECORE_CALLBACK_RENEW;
}

app_message_reader_s *app_message_reader_add(int fd, bool watch, app_message_cb callback, void *data)
{
	app_message_reader_s *r = calloc(1, sizeof(*r));
	if (r && watch)
		r->handler = ecore_main_fd_handler_add(fd, ECORE_FD_READ, reader_fd_cb, r, NULL, NULL);
	if (!r || (watch && !r->handler)) {
		LOGE("cannot watch a launch connection");
		free(r);
		close(fd);
		return NULL;
	}
	r->fd = fd;
	r->callback = callback;
	r->data = data;
	return r;
}

int app_message_reader_fd_get(const app_message_reader_s *reader)
{
	return reader ? reader->fd : -1;
}

void app_message_reader_del(app_message_reader_s *reader)
{
	if (!reader || reader->deleted)
		return;
	if (reader->dispatching) {
		reader->deleted = true;
		return;
	}
	reader_free(reader);
}
