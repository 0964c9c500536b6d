#include "ZQVFilePages.h"

namespace {

/// The toolkit opens and maps a file once, however often it is asked to.
void drop(const char* path) {
  Eina_File* file = eina_file_open(path, EINA_FALSE);
  if (!file) return;
  if (void* map = eina_file_map_all(file, EINA_FILE_DONTNEED)) eina_file_map_free(file, map);
  eina_file_close(file);
}

}  // namespace

void ZQVFilePages::dropWhenDecoded(Evas_Object* image) {
  evas_object_event_callback_add(image, EVAS_CALLBACK_IMAGE_PRELOADED, _preloadedCb, nullptr);
}

void ZQVFilePages::_preloadedCb(void*, Evas*, Evas_Object* image, void*) {
  const char* path = nullptr;
  evas_object_image_file_get(image, &path, nullptr);
  if (path) drop(path);
}
