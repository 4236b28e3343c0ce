// Fuzz target: bundle text as another process may send it, raw or as base64 of arbitrary records.
// A bundle that decodes must encode again to a text that decodes to the same keys and values.
// fuzz-sources: platform/src/app/bundle.c platform/src/app/bundle_codec.c
#include "bundle_codec.h"

#include <bundle.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

namespace
{
struct Entry {
	std::string key;
	int type;
	std::vector<std::string> values;
};

void collectCb(const char *key, const int type, const bundle_keyval_t *kv, void *data)
{
	Entry e{key, type, {}};
	bundle_keyval_t *keyval = const_cast<bundle_keyval_t *>(kv);
	if (bundle_keyval_type_is_array(keyval)) {
		void **values = nullptr;
		unsigned int count = 0;
		size_t *sizes = nullptr;
		if (bundle_keyval_get_array_val(keyval, &values, &count, &sizes) != BUNDLE_ERROR_NONE)
			abort();
		for (unsigned int i = 0; i < count; ++i)
			e.values.emplace_back(static_cast<const char *>(values[i]), sizes[i]);
	} else {
		void *value = nullptr;
		size_t size = 0;
		if (bundle_keyval_get_basic_val(keyval, &value, &size) != BUNDLE_ERROR_NONE)
			abort();
		e.values.emplace_back(static_cast<const char *>(value), size);
	}
	static_cast<std::vector<Entry> *>(data)->push_back(e);
}

std::vector<Entry> entriesOf(bundle *b)
{
	std::vector<Entry> entries;
	bundle_foreach(b, collectCb, &entries);
	return entries;
}

bool sameEntries(const std::vector<Entry> &a, const std::vector<Entry> &b)
{
	if (a.size() != b.size())
		return false;
	for (size_t i = 0; i < a.size(); ++i) {
		if (a[i].key != b[i].key || a[i].type != b[i].type || a[i].values != b[i].values)
			return false;
	}
	return true;
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
		text = encoded ? encoded : "";
		free(encoded);
	}
	bundle *b = bundle_decode(reinterpret_cast<const bundle_raw *>(text.data()), static_cast<int>(text.size()));
	if (!b)
		return 0;
	const std::vector<Entry> entries = entriesOf(b);
	if (static_cast<int>(entries.size()) != bundle_get_count(b))
		abort();
	for (const Entry &e : entries) {
		char *value = nullptr;
		if (e.type == BUNDLE_TYPE_STR && (bundle_get_str(b, e.key.c_str(), &value) != BUNDLE_ERROR_NONE || !value))
			abort();
	}
	bundle_raw *raw = nullptr;
	int len = 0;
	if (bundle_encode(b, &raw, &len) != BUNDLE_ERROR_NONE)
		abort();
	bundle *again = bundle_decode(raw, len);
	if (!again || !sameEntries(entries, entriesOf(again)))
		abort();
	bundle_free(again);
	bundle_free_encoded_rawdata(&raw);
	bundle_free(b);
	return 0;
}
