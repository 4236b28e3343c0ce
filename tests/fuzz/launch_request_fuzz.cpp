// Fuzz target: what another process may write on a launch socket, read by the receiver's message reader
// and decoded as a launch request. Raw streams try the framing (truncated, oversized, foreign); framed
// payloads of arbitrary records try the request decoder. A request that decodes must encode to a text
// that decodes again to the same text.
// fuzz-sources: platform/src/app/app_message.c platform/src/app/app_control.c platform/src/app/bundle.c
// fuzz-sources: platform/src/app/bundle_codec.c
// fuzz-pkgs: ecore evas
#include "app_private.h"
#include "bundle_codec.h"

#include <sys/socket.h>
#include <unistd.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>

namespace
{
struct Frame {
	uint32_t magic, major, ref, response, size;
};

bool extraCb(app_control_h request, const char *key, void *)
{
	char *value = nullptr;
	char **values = nullptr;
	int length = 0;
	if (app_control_get_extra_data(request, key, &value) == APP_CONTROL_ERROR_NONE)
		free(value);
	else if (app_control_get_extra_data_array(request, key, &values, &length) == APP_CONTROL_ERROR_NONE) {
		for (int i = 0; i < length; ++i)
			free(values[i]);
		free(values);
	}
	return true;
}

// The text of a request as a sender would write it; it frees the request.
std::string encodeAndFree(app_control_h request)
{
	bundle_raw *raw = nullptr;
	int len = 0;
	if (!app_control_encode_internal(request, "fuzz", true, &raw, &len))
		abort();
	std::string text(reinterpret_cast<char *>(raw), len);
	free(raw);
	app_control_destroy(request);
	return text;
}

void requestCb(void *, app_message_reader_s *, const app_message_s *msg)
{
	if (!msg || msg->major != APP_CHANNEL_MSG_LAUNCH || msg->size <= 0)
		return;
	app_control_h request = app_control_decode_internal(static_cast<const bundle_raw *>(msg->data), msg->size);
	if (!request)
		return;
	app_control_foreach_extra_data(request, extraCb, nullptr);
	const std::string once = encodeAndFree(request);
	app_control_h again = app_control_decode_internal(reinterpret_cast<const bundle_raw *>(once.data()), once.size());
	if (!again || encodeAndFree(again) != once)
		abort();
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
	if (size == 0)
		return 0;
	std::string stream;
	if (data[0] & 1) {
		stream.assign(reinterpret_cast<const char *>(data + 1), size - 1);
	} else {
		char *payload = bundle_base64_encode(data + 1, size - 1);
		const Frame frame{0x54415050u, APP_CHANNEL_MSG_LAUNCH, 1, static_cast<uint32_t>(data[0] >> 7),
		                  static_cast<uint32_t>(strlen(payload))};
		stream.assign(reinterpret_cast<const char *>(&frame), sizeof(frame));
		stream += payload;
		free(payload);
	}
	int fds[2];
	if (socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, fds) != 0)
		abort();
	int buffer = 1 << 20;
	setsockopt(fds[0], SOL_SOCKET, SO_RCVBUF, &buffer, sizeof(buffer));
	setsockopt(fds[1], SOL_SOCKET, SO_SNDBUF, &buffer, sizeof(buffer));
	if (write(fds[1], stream.data(), stream.size()) != static_cast<ssize_t>(stream.size()))
		abort();
	close(fds[1]);
	app_message_reader_s *reader = app_message_reader_add(fds[0], false, requestCb, nullptr);
	while (reader && app_message_reader_read(reader)) {
	}
	return 0;
}
