#include "Threads.h"

#include <Ecore.h>

#include <cstdlib>

namespace app_assist {
namespace {

/// One decodes a picture while the thread for the next one starts.
constexpr int kDecodingThreads = 2;

}  // namespace

void paintInMainThread() {
  setenv("ECORE_EVAS_FORCE_SYNC_RENDER", "1", 1);
}

void limitDecodingThreads() {
  ecore_thread_max_set(kDecodingThreads);
}

}  // namespace app_assist
