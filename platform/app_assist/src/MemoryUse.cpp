#include "MemoryUse.h"

#include <Elementary.h>

namespace app_assist {
namespace {

/// Of pictures that nothing shows any more: some thumbnails, for whoever turns back at once. More
/// would not help, as the next row needs decoding anyway.
constexpr int kPictureKilobytes = 1024;
/// Of memory that has been freed and is returned when there is time. Left alone, a scrolled grid's
/// old cells fill 16 megabytes, which then stay.
constexpr int kFreedBytes = 256 * 1024;

}  // namespace

void limitMemoryUse() {
  elm_config_cache_image_cache_size_set(kPictureKilobytes);
  eina_freeq_mem_max_set(eina_freeq_main_get(), kFreedBytes);
}

}  // namespace app_assist
