#pragma once

/// Text: a locale name for dates and numbers, such as "en_GB.UTF-8".
#define VCONFKEY_REGIONFORMAT "db/menu_widget/regionformat"
/// Text: the locale name of the language, such as "ko_KR.UTF-8".
#define VCONFKEY_LANGSET "db/menu_widget/language"
/// Int: one of the two below.
#define VCONFKEY_REGIONFORMAT_TIME1224 "db/menu_widget/regionformat_time1224"

#define VCONFKEY_TIME_FORMAT_12 1
#define VCONFKEY_TIME_FORMAT_24 2
