// A stranger's file or sender name on its way into markup: what is seen is what was sent.

#include "ZQVMarkup.h"

#include <Evas.h>

#include <cstdlib>
#include <memory>
#include <string>

namespace {

struct Free {
  void operator()(char* text) const { free(text); }
};

std::string visible(const std::string& markup) {
  std::unique_ptr<char, Free> text(evas_textblock_text_markup_to_utf8(nullptr, markup.c_str()));
  return text ? text.get() : "";
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const int ready = evas_init();
  (void)ready;
  const std::string name(reinterpret_cast<const char*>(data), size);
  for (const size_t limit : {0u, 7u, 64u, 900u}) {
    const std::string markup = zqvEscapeWithin(name.c_str(), limit);
    if (markup.size() > limit) abort();
    if (visible(markup).find('<') != std::string::npos && name.find('<') == std::string::npos) {
      abort();
    }
  }
  return 0;
}
