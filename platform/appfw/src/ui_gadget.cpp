#include <ui-gadget.h>

int UG_INIT_EFL(void* win, enum ug_option opt) {
  return win && opt >= UG_OPT_INDICATOR_ENABLE && opt < UG_OPT_MAX ? 0 : -1;
}
