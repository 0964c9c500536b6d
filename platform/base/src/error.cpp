#include <tizen.h>

#include <cstring>

namespace {
thread_local int lastResult = TIZEN_ERROR_NONE;
}

char* get_error_message(int err) {
  const char* text = "Unknown error";
  if (err == TIZEN_ERROR_NONE) {
    text = "Successful";
  } else if (err == TIZEN_ERROR_TIMED_OUT) {
    text = "Time out";
  } else if (err == TIZEN_ERROR_NOT_SUPPORTED) {
    text = "Not supported";
  } else if (err < 0 && err > -4096) {
    text = strerrordesc_np(-err);
  }
  return const_cast<char*>(text ? text : "Unknown error");
}

int get_last_result() {
  return lastResult;
}

void set_last_result(int err) {
  lastResult = err;
}
