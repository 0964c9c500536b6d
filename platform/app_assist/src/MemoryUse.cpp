#include "MemoryUse.h"

#include <Elementary.h>
#include <malloc.h>

namespace app_assist {
namespace {

/// Of pictures that nothing shows any more: some thumbnails, for whoever turns back at once. More
/// would not help, as the next row needs decoding anyway.
constexpr int kPictureKilobytes = 1024;
/// Of memory that has been freed and is returned when there is time. Left alone, a scrolled grid's
/// old cells fill 16 megabytes, which then stay.
constexpr int kFreedBytes = 256 * 1024;
/// A picture's pixels are larger than that, and go back to the system at once.
constexpr int kOwnMappingBytes = 128 * 1024;
/// By then the page that was asked for stands, and the one before it is gone.
constexpr double kAfterRequest = 0.5;

Ecore_Timer* returning = nullptr;

Eina_Bool returnCb(void*) {
  malloc_trim(0);
  returning = nullptr;
  return ECORE_CALLBACK_CANCEL;
}

}  // namespace

void limitFreedMemory() {
  // Threads that decode a picture now and then need no heap of their own, which would only grow.
  mallopt(M_ARENA_MAX, 1);
  mallopt(M_MMAP_THRESHOLD, kOwnMappingBytes);
}

void limitCaches() {
  elm_config_cache_image_cache_size_set(kPictureKilobytes);
  eina_freeq_mem_max_set(eina_freeq_main_get(), kFreedBytes);
}

void returnFreedMemorySoon() {
  if (returning) {
    ecore_timer_reset(returning);
  } else {
    returning = ecore_timer_add(kAfterRequest, returnCb, nullptr);
  }
}

}  // namespace app_assist
