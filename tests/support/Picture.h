/// Pictures to share, and what of them is to be seen on the screen.
#pragma once

#include <iosfwd>
#include <string>

#include "Phone.h"

namespace phone {

struct Colour {
  int red = 0, green = 0, blue = 0;

  /// Scaling and compression change a colour a little.
  bool isAbout(const Colour& other) const;
  bool operator==(const Colour& other) const;
  bool operator!=(const Colour& other) const { return !(*this == other); }
};

std::ostream& operator<<(std::ostream& out, const Colour& colour);

constexpr Colour kRed{220, 30, 40};
constexpr Colour kGreen{30, 170, 60};
constexpr Colour kBlue{40, 60, 210};

/// A picture of one colour; its kind is that of the name's ending, jpg or png. Sizes in pixels.
std::string makePicture(const Phone& phone, const std::string& name, const Colour& colour,
                        int width = 320, int height = 320);
/// A JPEG photo of 12 megapixels with upright stripes so narrow that only a picture which has as
/// many pixels as the screen is wide shows them.
std::string makeStripes(const Phone& phone, const std::string& name);
/// A picture that is red for a second and blue for a second, again and again; its kind is
/// that of the name's ending, gif or webp.
std::string makeAnimation(const Phone& phone, const std::string& name);
/// A PNG file that claims to have this size and has no content.
std::string pngHeader(unsigned width, unsigned height);

/// The colour of one pixel of the screen.
Colour colourAt(const Phone& phone, int x, int y);
/// How much the pixels of a row, one pixel high, differ from their neighbours: of 255, on average.
int contrastIn(const Phone& phone, const Area& row);
/// What the screen shows there, as bytes to compare; empty when that is not on the screen.
std::string pixelsOf(const Phone& phone, const Area& area);
/// The colour in the middle of the first widget of that name; black when there is none.
Colour colourOf(const Phone& phone, const std::string& name);

}  // namespace phone
