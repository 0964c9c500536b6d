// set_vconf KEY TEXT: another process that sets a key.
#include <vconf.h>

int main(int argc, char** argv) {
  return argc == 3 && vconf_set_str(argv[1], argv[2]) == VCONF_OK ? 0 : 1;
}
