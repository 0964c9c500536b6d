#include <base/Fault.h>
#include <ui-gadget.h>

int UG_INIT_EFL(void* win, enum ug_option opt) {
  if (base::strikes(__func__)) return -1;
  return win && opt >= UG_OPT_INDICATOR_ENABLE && opt < UG_OPT_MAX ? 0 : -1;
}
