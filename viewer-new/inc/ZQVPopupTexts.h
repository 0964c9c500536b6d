/// What the two download popups have in common: a Cancel and a Download button.
#pragma once

#include <Elementary.h>

#define ZQV_POPUP_CANCEL "IDS_RSH_BUTTON_CANCEL_ABB2"
#define ZQV_POPUP_DOWNLOAD "IDS_RSH_BUTTON_DOWNLOAD_ABB3"

/// Sets the texts of both buttons again; a missing button is logged.
void zqvUpdatePopupButtons(Evas_Object* popup);
