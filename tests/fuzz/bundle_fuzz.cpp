// Fuzz target: bundle text as another process may send it, raw or as base64 of arbitrary records.
// A bundle that decodes must encode to a text that decodes again to the same text.
// fuzz-sources: platform/src/app/bundle.c platform/src/app/bundle_codec.c
#include "bundle_codec.h"

#include <bundle.h>

#include <cstdint>
#include <cstdlib>
#include <string>

namespace
{
// The text of a bundle; it frees the bundle.
std::string encodeAndFree(bundle *b)
{
	bundle_raw *raw = nullptr;
	int len = 0;
	if (bundle_encode(b, &raw, &len) != BUNDLE_ERROR_NONE)
		abort();
	std::string text(reinterpret_cast<char *>(raw), len);
	bundle_free_encoded_rawdata(&raw);
	bundle_free(b);
	return text;
}

void readCb(const char *key, const int, const bundle_keyval_t *kv, void *data)
{
	void *value = nullptr;
	size_t size = 0;
	bundle_keyval_t *keyval = const_cast<bundle_keyval_t *>(kv);
	if (!bundle_keyval_type_is_array(keyval) && bundle_keyval_get_basic_val(keyval, &value, &size) == 0 &&
	    bundle_get_type(static_cast<bundle *>(data), key) == BUNDLE_TYPE_STR &&
	    !bundle_get_val(static_cast<bundle *>(data), key))
		abort();
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
	if (size == 0)
		return 0;
	// The first byte chooses: the bytes as the text itself, or the bytes as the records inside a text.
	std::string text(reinterpret_cast<const char *>(data + 1), size - 1);
	if (data[0] & 1) {
		char *encoded = bundle_base64_encode(data + 1, size - 1);
		text = encoded;
		free(encoded);
	}
	bundle *b = bundle_decode(reinterpret_cast<const bundle_raw *>(text.data()), static_cast<int>(text.size()));
	if (!b)
		return 0;
	bundle_foreach(b, readCb, b);
	const std::string once = encodeAndFree(b);
	bundle *again = bundle_decode(reinterpret_cast<const bundle_raw *>(once.data()), static_cast<int>(once.size()));
	if (!again || encodeAndFree(again) != once)
		abort();
	return 0;
}
