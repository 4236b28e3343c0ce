// Shrinking a 12-megapixel camera JPEG the way the editor does on its worker thread:
// size check, EXIF orientation, decode with downscale + resize + encode, upright turn.
// Also the bare decode at full size and with the decoder's downscale, for comparison.
#include "Util/MemoUtil.h"

#include <Ecore_Evas.h>
#include <Ecore_File.h>
#include <benchmark/benchmark.h>
#include <image_util.h>
#include <libexif/exif-data.h>

#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "BenchEnv.h"
#include "BenchPhoto.h"

using namespace memo_bench;

namespace
{
std::string gDir;
std::string gPhoto;

// Tags the photo as taken upright in portrait (orientation 6), as a phone camera does.
bool tagPortrait(const std::string &path)
{
	ExifData *exif = exif_data_new();
	ExifEntry *entry = exif_entry_new();
	exif_content_add_entry(exif->ifd[EXIF_IFD_0], entry);
	exif_entry_initialize(entry, EXIF_TAG_ORIENTATION);
	exif_set_short(entry->data, exif_data_get_byte_order(exif), 6);
	exif_entry_unref(entry);
	unsigned char *app1 = nullptr;
	unsigned int len = 0;
	exif_data_save_data(exif, &app1, &len);
	exif_data_unref(exif);
	FILE *in = fopen(path.c_str(), "rb");
	if (!app1 || !in) {
		free(app1);
		if (in)
			fclose(in);
		return false;
	}
	std::vector<unsigned char> jpeg;
	int c;
	while ((c = fgetc(in)) != EOF)
		jpeg.push_back(static_cast<unsigned char>(c));
	fclose(in);
	const unsigned char marker[] = {0xff, 0xe1, static_cast<unsigned char>((len + 2) >> 8),
	                                static_cast<unsigned char>((len + 2) & 0xff)};
	FILE *out = fopen(path.c_str(), "wb");
	bool ok = out && jpeg.size() > 2;
	if (ok) {
		fwrite(jpeg.data(), 1, 2, out);
		fwrite(marker, 1, sizeof(marker), out);
		fwrite(app1, 1, len, out);
		fwrite(jpeg.data() + 2, 1, jpeg.size() - 2, out);
	}
	if (out)
		fclose(out);
	free(app1);
	return ok;
}

void BM_InsertShrink12MP(benchmark::State &state)
{
	const std::string copy = gDir + "/copy.jpg";
	for (auto _ : state) {
		state.PauseTiming();
		ecore_file_cp(gPhoto.c_str(), copy.c_str());
		state.ResumeTiming();

		int w = 0, h = 0, error = 0;
		float scale = 1.0f;
		if (!MemoUtil::getInsertImageSize(copy.c_str(), &w, &h, &error, &scale)) {
			state.SkipWithError("the photo should need shrinking");
			break;
		}
		int orient = MemoUtil::getOrient(copy.c_str());
		MemoUtil::resizeImageJpg(copy.c_str(), copy.c_str(), w, h, scale);
		MemoUtil::rotateImage(copy.c_str(), orient);
	}
}
BENCHMARK(BM_InsertShrink12MP)->Unit(benchmark::kMillisecond);

void BM_Decode12MP(benchmark::State &state)
{
	const image_util_scale_e scale = static_cast<image_util_scale_e>(state.range(0));
	for (auto _ : state) {
		unsigned char *buf = nullptr;
		int w = 0, h = 0;
		unsigned int size = 0;
		image_util_decode_jpeg_with_downscale(gPhoto.c_str(), IMAGE_UTIL_COLORSPACE_RGB888, scale, &buf, &w, &h, &size);
		benchmark::DoNotOptimize(buf);
		free(buf);
	}
}
BENCHMARK(BM_Decode12MP)->Arg(IMAGE_UTIL_DOWNSCALE_1_1)->Arg(IMAGE_UTIL_DOWNSCALE_1_4)->Unit(benchmark::kMillisecond);
} // namespace

int main(int argc, char **argv)
{
	gDir = setUpPrivateRoot("image");
	if (gDir.empty())
		return 2;
	gPhoto = gDir + "/photo.jpg";
	ecore_evas_init();
	if (!makePhoto(gPhoto, 12345) || !tagPortrait(gPhoto)) {
		fprintf(stderr, "cannot write the test photo\n");
		return 2;
	}
	fprintf(stderr, "photo: %dx%d, %lld bytes\n", PHOTO_W, PHOTO_H,
	        static_cast<long long>(ecore_file_size(gPhoto.c_str())));

	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	benchmark::Shutdown();

	ecore_evas_shutdown();
	ecore_file_recursive_rm(gDir.c_str());
	return 0;
}
