/// UI gadgets: pages of other applications inside this one's window.
#pragma once

#ifdef __cplusplus
extern "C" {
#endif

enum ug_option {
  UG_OPT_INDICATOR_ENABLE = 0,
  UG_OPT_INDICATOR_PORTRAIT_ONLY = 1,
  UG_OPT_INDICATOR_LANDSCAPE_ONLY = 2,
  UG_OPT_INDICATOR_DISABLE = 3,
  UG_OPT_INDICATOR_MANUAL = 4,
  UG_OPT_MAX
};

/// 0, or -1 without a window or with an unknown option. The window stays the caller's.
int UG_INIT_EFL(void* win, enum ug_option opt);

#ifdef __cplusplus
}
#endif
