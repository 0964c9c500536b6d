#include "ZQVFrames.h"

#include "ZQVCommon.h"

#define SMALL_FRAME(number) \
  ZQV_IMAGE_DIR "zq_ic_download_progress/31/zq_ic_download_process" number ".png"
#define LARGE_FRAME(number) \
  ZQV_IMAGE_DIR "zq_ic_download_progress/55/zq_ic_download_process_02_" number ".png"

const char* zqvDownloadedSmallFrames[] = {ZQV_IMAGE_DIR "zq_ic_downloaded_02.png", nullptr};
const char* zqvDownloadedLargeFrames[] = {ZQV_IMAGE_DIR "zq_ic_downloaded.png", nullptr};
const char* zqvDownloadingSmallFrames[] = {
    SMALL_FRAME("00"), SMALL_FRAME("01"), SMALL_FRAME("02"), SMALL_FRAME("03"),
    SMALL_FRAME("04"), SMALL_FRAME("05"), SMALL_FRAME("06"), nullptr};
const char* zqvDownloadingLargeFrames[] = {
    LARGE_FRAME("00"), LARGE_FRAME("01"), LARGE_FRAME("02"), LARGE_FRAME("03"),
    LARGE_FRAME("04"), LARGE_FRAME("05"), LARGE_FRAME("06"), nullptr};
