/// Text that carries the values of a text class by value, as mark-up made from a class does:
/// <font=FONT text_class=CODE><font_size=SIZE><color=#RRGGBB>…
#pragma once

#include <Evas.h>

#include <functional>
#include <string>

namespace app_assist {

struct TextClassValues {
  int size;
  unsigned rgb;
};

/// The values of a code as they are now; false when the code is unknown.
using TextClassLookup = std::function<bool(const std::string& code, TextClassValues* values)>;

/// The same text with the values of now. What does not look like the above stays untouched.
std::string refreshedMarkup(const std::string& markup, const TextClassLookup& lookup);

/// Brings all that a window shows up to date after the palette or the size of texts has changed:
/// labels as above, grids and lists by building what is in sight again.
void refreshTexts(Evas_Object* window);

}  // namespace app_assist
