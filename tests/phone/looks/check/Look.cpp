#include "Look.h"

#include <algorithm>
#include <chrono>
#include <thread>

namespace {

using Clock = std::chrono::steady_clock;

constexpr auto kPatience = std::chrono::seconds(20);
constexpr auto kBetweenLooks = std::chrono::milliseconds(40);

common::OwnedVariant ask(GDBusConnection* bus) {
  return common::OwnedVariant(
      g_dbus_connection_call_sync(bus, "phone.Looks", "/phone/Looks", "phone.Looks1", "Look",
                                  nullptr, G_VARIANT_TYPE("(s(iii)a(sbbbb(iiii)(iiii)d))"),
                                  G_DBUS_CALL_FLAGS_NO_AUTO_START, -1, nullptr, nullptr));
}

bool isIn(GVariant* answer, const std::string& language) {
  const char* now = nullptr;
  g_variant_get_child(answer, 0, "&s", &now);
  return language == now;
}

Text readText(GVariant* answer) {
  Text text;
  const char* words = nullptr;
  gboolean isCutOff = FALSE, mayEndInDots = FALSE, scrolls = FALSE, isInPopup = FALSE;
  Area &lines = text.lines, &seen = text.seen;
  g_variant_get(answer, "(&sbbbb(iiii)(iiii)d)", &words, &isCutOff, &mayEndInDots, &scrolls,
                &isInPopup, &lines.x, &lines.y, &lines.width, &lines.height, &seen.x, &seen.y,
                &seen.width, &seen.height, &text.scale);
  text.words = words;
  text.isCutOff = isCutOff;
  text.mayEndInDots = mayEndInDots;
  text.scrolls = scrolls;
  text.isInPopup = isInPopup;
  return text;
}

Look read(GVariant* answer) {
  Look look;
  const char* language = nullptr;
  common::OwnedVariant texts;
  g_variant_get(answer, "(&s(iii)@*)", &language, &look.screen.width, &look.screen.height,
                &look.rotation, static_cast<GVariant**>(common::Out(texts)));
  look.language = language;
  for (gsize i = 0; i < g_variant_n_children(texts.get()); i++) {
    const common::OwnedVariant text(g_variant_get_child_value(texts.get(), i));
    look.texts.push_back(readText(text.get()));
  }
  return look;
}

}  // namespace

Area overlap(const Area& a, const Area& b) {
  Area both;
  both.x = std::max(a.x, b.x);
  both.y = std::max(a.y, b.y);
  both.width = std::max(0, std::min(a.right(), b.right()) - both.x);
  both.height = std::max(0, std::min(a.bottom(), b.bottom()) - both.y);
  return both;
}

std::optional<Look> lookIn(GDBusConnection* bus, const std::string& language) {
  common::OwnedVariant before;
  for (const auto end = Clock::now() + kPatience; Clock::now() < end;) {
    common::OwnedVariant now = ask(bus);
    if (now && before && isIn(now.get(), language) && g_variant_equal(now.get(), before.get())) {
      return read(now.get());
    }
    before = std::move(now);
    std::this_thread::sleep_for(kBetweenLooks);
  }
  return std::nullopt;
}
