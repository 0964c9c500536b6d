// phone-account none | off NUMBER | on NUMBER: the account with the sign-up service. "off" is an
// account for which the sharing service is switched off.

#include <AccountStore.h>
#include <ovu.h>

#include <cstdio>
#include <string>

namespace {

constexpr const char* kService = OVU_SERVICE_SHARE;
constexpr int kWrongCall = 2;

bool change(ovu::AccountStore& store, const std::string& what, const std::string& number) {
  if (what == "none") return store.remove();
  return (store.account() || store.signUp(number)) && store.switchService(kService, what == "on");
}

}  // namespace

int main(int argc, char** argv) {
  const std::string what = argc > 1 ? argv[1] : "";
  if (argc > 3 || (what != "none" && (argc != 3 || (what != "off" && what != "on")))) {
    fputs("phone-account none | off NUMBER | on NUMBER\n", stderr);
    return kWrongCall;
  }
  ovu::AccountStore store;
  if (store.isOpen() && change(store, what, argc > 2 ? argv[2] : "")) return 0;
  fputs("phone-account: the account store cannot be written\n", stderr);
  return 1;
}
