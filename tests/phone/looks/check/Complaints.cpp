#include "Complaints.h"

#include <algorithm>

namespace {

constexpr int kRounding = 2;
/// Smaller than this and a button's text is hard to read beside the others.
constexpr double kSmallest = 0.75;
constexpr double kDesignWidth = 720;
/// The margin of a page, with some room for the bearing of letters.
constexpr double kMargin = 36 / kDesignWidth;

double unit(const Look& look) {
  return std::min(look.screen.width, look.screen.height);
}

bool isHiddenInPart(const Text& text, const Look& look) {
  const Area seen = overlap(text.seen, look.screen);
  if (seen.width < text.lines.width - kRounding) return true;
  // What scrolls may end anywhere.
  return !text.scrolls && seen.height < text.lines.height - kRounding;
}

bool lieOverEachOther(const Text& a, const Text& b) {
  if (a.isInPopup != b.isInPopup) return false;
  const Area both = overlap(a.seen, b.seen);
  return both.width > kRounding && both.height > kRounding;
}

std::string quoted(const Text& text) {
  return '"' + text.words + '"';
}

/// The part of a message before and the part after what it leaves open.
std::pair<std::string, std::string> endsOf(const std::string& message) {
  const size_t first = message.find('%');
  if (first == std::string::npos) return {message, ""};
  const size_t last = message.find_first_of("sd", message.rfind('%'));
  return {message.substr(0, first), message.substr(last + 1)};
}

const Text* find(const Look& look, const std::string& message) {
  const auto [before, after] = endsOf(message);
  const auto fits = [&, &before = before, &after = after](const Text& text) {
    const size_t at = text.words.find(before);
    return at != std::string::npos &&
           text.words.find(after, at + before.size()) != std::string::npos;
  };
  const auto found = std::find_if(look.texts.begin(), look.texts.end(), fits);
  return found == look.texts.end() ? nullptr : &*found;
}

}  // namespace

std::vector<std::string> complaintsAbout(const Look& look, bool isTextLarger) {
  std::vector<std::string> all;
  const auto complain = [&](const Text& text, const std::string& what) {
    all.push_back(look.language + ": " + quoted(text) + ' ' + what);
  };
  for (size_t i = 0; i < look.texts.size(); i++) {
    const Text& text = look.texts[i];
    if (text.words.find("IDS_") != std::string::npos) complain(text, "is no text");
    if (text.isCutOff && !(isTextLarger && text.mayEndInDots)) complain(text, "is cut off");
    if (isHiddenInPart(text, look)) complain(text, "is hidden in part");
    if (text.scale < kSmallest * unit(look) / kDesignWidth) complain(text, "is too small");
    for (size_t j = 0; j < i; j++) {
      if (lieOverEachOther(text, look.texts[j])) {
        complain(text, "lies over " + quoted(look.texts[j]));
      }
    }
  }
  return all;
}

bool shows(const Look& look, const std::string& message) {
  return find(look, message) != nullptr;
}

bool beginsAtTheMargin(const Look& look, const std::string& message, bool isRightToLeft) {
  const Text* text = find(look, message);
  if (!text) return false;
  const int distance = isRightToLeft ? look.screen.width - text->lines.right() : text->lines.x;
  return distance >= 0 && distance <= kMargin * unit(look);
}
