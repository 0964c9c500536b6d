// Loaded into the viewer by the tests of its looks: tells every text that its windows draw, where,
// and how large it would like to be. On the session bus as phone.Looks.

#include <Ecore_Evas.h>
#include <Evas.h>
#include <gio/gio.h>

#include <algorithm>
#include <clocale>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>

namespace {

constexpr const char* kInterface = R"xml(<node><interface name="phone.Looks1">
<method name="Look">
<arg type="s" name="language" direction="out"/>
<arg type="(iii)" name="width, height, rotation" direction="out"/>
<arg type="a(sbbbb(iiii)(iiii)d)" name="texts" direction="out"/>
</method></interface></node>)xml";

struct Area {
  int x = 0, y = 0, width = 0, height = 0;
};

Area common(const Area& a, const Area& b) {
  Area both;
  both.x = std::max(a.x, b.x);
  both.y = std::max(a.y, b.y);
  both.width = std::max(0, std::min(a.x + a.width, b.x + b.width) - both.x);
  both.height = std::max(0, std::min(a.y + a.height, b.y + b.height) - both.y);
  return both;
}

Area areaOf(Evas_Object* object) {
  Area area;
  evas_object_geometry_get(object, &area.x, &area.y, &area.width, &area.height);
  return area;
}

/// Where an object is drawn, and whether that is part of what moves below a finger, or of a popup.
struct Place {
  Area seen;
  bool scrolls = false;
  bool isInPopup = false;
};

bool isOneOf(const char* type, std::initializer_list<const char*> types) {
  return std::any_of(types.begin(), types.end(),
                     [&](const char* one) { return !strcmp(type, one); });
}

/// What clips the object leaves of it; nothing when it is hidden or transparent.
Area seenOf(Evas_Object* object, Area area) {
  int alpha = 255;
  evas_object_color_get(object, nullptr, nullptr, nullptr, &alpha);
  if (alpha == 0) return {};
  for (Evas_Object* clip = evas_object_clip_get(object); clip; clip = evas_object_clip_get(clip)) {
    evas_object_color_get(clip, nullptr, nullptr, nullptr, &alpha);
    if (alpha == 0 || !evas_object_visible_get(clip)) return {};
    area = common(area, areaOf(clip));
  }
  return area;
}

/// All that its style says, the later before the earlier.
std::string styleOf(Evas_Object* text) {
  std::string all;
  const Evas_Textblock_Style* const styles[] = {evas_object_textblock_style_user_peek(text),
                                                evas_object_textblock_style_get(text)};
  for (const Evas_Textblock_Style* style : styles) {
    const char* words = style ? evas_textblock_style_get(style) : nullptr;
    if (words) all += std::string(words) + ' ';
  }
  return all;
}

/// What may end in dots has one line.
bool wraps(const std::string& style) {
  const size_t at = style.find("wrap=");
  return at != std::string::npos && style.compare(at, strlen("wrap=none"), "wrap=none") != 0 &&
         style.find("ellipsis=") == std::string::npos;
}

int firstLineHeight(Evas_Object* text) {
  int height = 0;
  evas_object_textblock_line_number_geometry_get(text, 0, nullptr, nullptr, nullptr, &height);
  return height;
}

bool mayEndInDots(Evas_Object* text) {
  return styleOf(text).find("ellipsis=") != std::string::npos;
}

bool isCutOff(Evas_Object* text, const Area& area) {
  constexpr int kRounding = 2;
  int width = 0, height = 0, natural = 0;
  evas_object_textblock_size_formatted_get(text, &width, &height);
  evas_object_textblock_size_native_get(text, &natural, nullptr);
  // The space after a line of Hebrew or Arabic hangs over its end.
  const int space = firstLineHeight(text) / 5;
  const bool tooWide = wraps(styleOf(text)) ? width > area.width + space + kRounding
                                            : natural > area.width + kRounding;
  return tooWide || height > area.height + kRounding;
}

/// The lines, without the room around them.
Area linesOf(Evas_Object* text, const Area& area) {
  int left = area.width, top = area.height, right = 0, bottom = 0;
  int x = 0, y = 0, width = 0, height = 0;
  for (int i = 0; evas_object_textblock_line_number_geometry_get(text, i, &x, &y, &width, &height);
       i++) {
    if (width <= 0) continue;
    left = std::min(left, x);
    top = std::min(top, y);
    right = std::max(right, x + width);
    bottom = std::max(bottom, y + height);
  }
  return {area.x + left, area.y + top, std::max(0, right - left), std::max(0, bottom - top)};
}

void addText(GVariantBuilder* texts, Evas_Object* text, const Place& place) {
  const Area area = areaOf(text);
  const std::unique_ptr<char, decltype(&free)> plain(
      evas_textblock_text_markup_to_utf8(text, evas_object_textblock_text_markup_get(text)), free);
  if (!plain || !*plain) return;
  const Area lines = linesOf(text, area);
  const Area seen = seenOf(text, lines);
  if (seen.width == 0 || seen.height == 0) return;
  g_variant_builder_add(texts, "(sbbbb(iiii)(iiii)d)", plain.get(), isCutOff(text, area),
                        mayEndInDots(text), place.scrolls, place.isInPopup, lines.x, lines.y,
                        lines.width, lines.height, seen.x, seen.y, seen.width, seen.height,
                        evas_object_scale_get(text));
}

void add(GVariantBuilder* texts, Evas_Object* object, Place place) {
  const char* type = evas_object_type_get(object);
  if (!type || !evas_object_visible_get(object)) return;
  if (strcmp(type, "textblock") == 0) {
    addText(texts, object, place);
    return;
  }
  place.scrolls |= isOneOf(type, {"elm_gengrid", "elm_genlist", "elm_scroller"});
  place.isInPopup |= isOneOf(type, {"elm_popup", "elm_notify"});
  Eina_List* members = evas_object_smart_members_get(object);
  while (members) {
    add(texts, static_cast<Evas_Object*>(eina_list_data_get(members)), place);
    members = eina_list_remove_list(members, members);
  }
}

void addWindow(GVariantBuilder* texts, Evas* canvas) {
  evas_smart_objects_calculate(canvas);
  for (Evas_Object* object = evas_object_bottom_get(canvas); object;
       object = evas_object_above_get(object)) {
    add(texts, object, {});
  }
}

GVariant* look() {
  GVariantBuilder texts;
  g_variant_builder_init(&texts, G_VARIANT_TYPE("a(sbbbb(iiii)(iiii)d)"));
  int width = 0, height = 0, rotation = 0;
  Eina_List* windows = ecore_evas_ecore_evas_list_get();
  while (windows) {
    auto* window = static_cast<Ecore_Evas*>(eina_list_data_get(windows));
    windows = eina_list_remove_list(windows, windows);
    if (!ecore_evas_visibility_get(window)) continue;
    evas_output_size_get(ecore_evas_get(window), &width, &height);
    rotation = ecore_evas_rotation_get(window);
    addWindow(&texts, ecore_evas_get(window));
  }
  const char* language = setlocale(LC_MESSAGES, nullptr);
  return g_variant_new("(s(iii)a(sbbbb(iiii)(iiii)d))", language ? language : "", width, height,
                       rotation, &texts);
}

void calledCb(GDBusConnection*, const char*, const char*, const char*, const char*, GVariant*,
              GDBusMethodInvocation* call, void*) {
  g_dbus_method_invocation_return_value(call, look());
}

void connectedCb(GDBusConnection* bus, const char*, void*) {
  static const GDBusInterfaceVTable kCalls = {calledCb, nullptr, nullptr, {}};
  GDBusNodeInfo* node = g_dbus_node_info_new_for_xml(kInterface, nullptr);
  g_dbus_connection_register_object(bus, "/phone/Looks", node->interfaces[0], &kCalls, nullptr,
                                    nullptr, nullptr);
  g_dbus_node_info_unref(node);
}

/// The programs that start the viewer are loaded with this, too; they have no use for it.
__attribute__((constructor)) void start() {
  if (strcmp(program_invocation_short_name, "zelqo-viewer") != 0) return;
  g_bus_own_name(G_BUS_TYPE_SESSION, "phone.Looks", G_BUS_NAME_OWNER_FLAGS_ALLOW_REPLACEMENT,
                 connectedCb, nullptr, nullptr, nullptr, nullptr);
}

}  // namespace
