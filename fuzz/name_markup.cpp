// A stranger's file or sender name on its way into markup: what is seen is what was sent.

#include "Require.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"

#include <Evas.h>
#include <stddef.h>
#include <stdint.h>

#include <string>

namespace {

std::string shown(const std::string& markup) {
  const ZQVPlatformText text(evas_textblock_text_markup_to_utf8(nullptr, markup.c_str()));
  return text ? text.get() : "";
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const int ready = evas_init();
  require(ready > 0);
  const std::string name(reinterpret_cast<const char*>(data), size);
  const std::string whole = shown(zqvEscapeWithin(name.c_str(), SIZE_MAX));
  require(whole.find('\n') == std::string::npos);
  // A text of its own is not changed by going the same way again, and nothing in it is a tag.
  require(shown(zqvEscapeWithin(whole.c_str(), SIZE_MAX)) == whole);
  for (const size_t limit : {0u, 7u, 64u, 900u}) {
    const std::string markup = zqvEscapeWithin(name.c_str(), limit);
    const std::string cut = shown(markup);
    require(markup.size() <= limit && whole.compare(0, cut.size(), cut) == 0);
  }
  return 0;
}
