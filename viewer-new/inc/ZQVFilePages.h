#pragma once

#include <Evas.h>

/// The toolkit keeps the whole file of a JPEG picture mapped for as long as the picture exists,
/// which is more memory than the picture itself takes at the size of a page.
class ZQVFilePages {
 public:
  /// Gives the file's pages back whenever the image has been decoded in the background. They would
  /// come again if somebody read them.
  static void dropWhenDecoded(Evas_Object* image);

 private:
  static void _preloadedCb(void* data, Evas* canvas, Evas_Object* image, void* info);
};
