#include "WGenlistItemMonoline1Icon.h"

#include <efl_assist.h>

#include "ZQVContacts.h"
#include "ZQVPictureGate.h"
#include "ZQVRows.h"

namespace {

constexpr const char* kIconPart = "elm.icon.1";
constexpr const char* kMask = ZQV_IMAGE_DIR "contacts_caller_id_default_masking_02.png";
constexpr const char* kDefaultColour = "A03O003L1";
constexpr int kPhotoSide = 74;

bool isDrawnPicture(const char* path) {
  return zqvIsOneOf(path, {ZQV_DEFAULT_CALLER_IMAGE, ZQV_GROUP_CALLER_IMAGE});
}

void showDrawnPicture(Evas_Object* image, const char* path) {
  elm_image_file_set(image, path, nullptr);
  ea_theme_object_color_set(image, kDefaultColour);
}

/// Cuts a photo to the shape of the mask; false when the photo cannot be read.
bool showPhoto(Evas_Object* image, const char* path) {
  if (!ZQVPictureGate::passes(path, ZQVPictureGate::FullView)) return false;
  ZQVOwned<uint32_t, free> pixels(
      static_cast<uint32_t*>(ea_image_effect_mask(path, kMask, kPhotoSide, kPhotoSide, 0, 0)));
  Evas_Object* inner = elm_image_object_get(image);
  if (!pixels || !inner) return false;
  evas_object_image_colorspace_set(inner, EVAS_COLORSPACE_ARGB8888);
  evas_object_image_size_set(inner, kPhotoSide, kPhotoSide);
  evas_object_image_alpha_set(inner, EINA_TRUE);
  evas_object_image_data_copy_set(inner, pixels.get());
  evas_object_image_data_update_add(inner, 0, 0, kPhotoSide, kPhotoSide);
  evas_object_size_hint_aspect_set(image, EVAS_ASPECT_CONTROL_HORIZONTAL, 1, 1);
  return true;
}

}  // namespace

WGenlistItemMonoline1Icon::WGenlistItemMonoline1Icon(const char* text, const char* imagePath) {
  setText(text);
  setImage(imagePath);
}

WGenlistItemMonoline1Icon::~WGenlistItemMonoline1Icon() = default;

Elm_Genlist_Item_Class* WGenlistItemMonoline1Icon::getItemClass() {
  static Elm_Genlist_Item_Class rowClass = zqvRowClass("1line", _textCb, _contentCb);
  return &rowClass;
}

void WGenlistItemMonoline1Icon::setText(const char* text) {
  _text.reset(g_strdup(text));
}

void WGenlistItemMonoline1Icon::setImage(const char* imagePath) {
  _imagePath.reset(imagePath && *imagePath ? g_strdup(imagePath) : nullptr);
}

char* WGenlistItemMonoline1Icon::_textCb(void* data, Evas_Object*, const char* part) {
  if (!data || !zqvIsOneOf(part, {"elm.text.main.left", "elm.text.main"})) return nullptr;
  return zqvRowText(zqvRowOf<WGenlistItemMonoline1Icon>(data)->_text.get());
}

Evas_Object* WGenlistItemMonoline1Icon::_contentCb(void* data, Evas_Object* list,
                                                   const char* part) {
  if (!data || !zqvIsOneOf(part, {kIconPart})) return nullptr;
  Evas_Object* layout = elm_layout_add(list);
  elm_layout_theme_set(layout, "layout", "list/B/type.2", "default");
  elm_object_part_content_set(layout, "elm.swallow.content",
                              zqvRowOf<WGenlistItemMonoline1Icon>(data)->_createImage(layout));
  return layout;
}

Evas_Object* WGenlistItemMonoline1Icon::_createImage(Evas_Object* parent) const {
  Evas_Object* image = elm_image_add(parent);
  const char* path = _imagePath ? _imagePath.get() : ZQV_DEFAULT_CALLER_IMAGE;
  if (isDrawnPicture(path)) {
    showDrawnPicture(image, path);
  } else if (!showPhoto(image, path)) {
    showDrawnPicture(image, ZQV_DEFAULT_CALLER_IMAGE);
  }
  evas_object_size_hint_align_set(image, EVAS_HINT_FILL, EVAS_HINT_FILL);
  evas_object_size_hint_weight_set(image, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
  evas_object_show(image);
  return image;
}
