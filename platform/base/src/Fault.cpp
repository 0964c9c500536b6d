#include <base/Fault.h>

#include <dlog.h>

#include <cstdio>
#include <cstdlib>

namespace base {
namespace {

struct Plan {
  const char* const failing = getenv("PLATFORM_FAIL_CALL");
  const char* const file = getenv("PLATFORM_COUNT_CALLS");
  const long n = failing ? atol(failing) : 0;
  FILE* const record = file ? fopen(file, "ae") : nullptr;
  const bool isOn = failing || file;
  long calls = 0;
};

}  // namespace

bool strikes(const char* call) {
  static auto* plan = new Plan;
  if (!plan->isOn) return false;
  plan->calls++;
  if (plan->record) {
    fprintf(plan->record, "%s\n", call);
    fflush(plan->record);
  }
  if (plan->calls != plan->n) return false;
  dlog_print(DLOG_WARN, "PLATFORM", "call %ld, %s, is made to fail", plan->n, call);
  return true;
}

}  // namespace base
