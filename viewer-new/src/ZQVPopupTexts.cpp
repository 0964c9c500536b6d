#include "ZQVPopupTexts.h"

#include "ZQVLog.h"
#include "ZQVText.h"

void zqvUpdatePopupButtons(Evas_Object* popup) {
  Evas_Object* cancel = elm_object_part_content_get(popup, "button1");
  if (!cancel) {
    ZQV_ERROR("btn1 is null!");
    return;
  }
  elm_object_domain_translatable_text_set(cancel, ZQV_TEXT_DOMAIN, ZQV_POPUP_CANCEL);
  Evas_Object* download = elm_object_part_content_get(popup, "button2");
  if (!download) {
    ZQV_ERROR("btn2 is null!");
    return;
  }
  elm_object_domain_translatable_text_set(download, ZQV_TEXT_DOMAIN, ZQV_POPUP_DOWNLOAD);
}
