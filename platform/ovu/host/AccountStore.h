/// The phone's one account with the sign-up service and the services switched on there.
#pragma once

#include <memory>
#include <optional>
#include <string>

namespace ovu {

struct Account {
  std::string imsi;    ///< identity of the subscriber
  std::string msisdn;  ///< number in international form, may be empty
};

class AccountStore {
 public:
  /// The phone's own.
  AccountStore();
  explicit AccountStore(const std::string& path);
  ~AccountStore();
  AccountStore(const AccountStore&) = delete;
  AccountStore& operator=(const AccountStore&) = delete;

  /// False when the database could not be opened; everything else then fails.
  bool isOpen() const;

  /// No account: nothing. A store that fails answers the same and sets `*failed`.
  std::optional<Account> account(bool* failed = nullptr) const;

  /// Makes or replaces the account, with the sharing service switched on. An empty `imsi` means
  /// that of the SIM card in the modem, or one made from the number when there is no modem.
  bool signUp(const std::string& msisdn, const std::string& imsi = {});

  /// Forgets the account and its services.
  bool remove();

  /// A service that was never switched is off.
  bool isServiceOn(const std::string& service, bool* failed = nullptr) const;
  bool switchService(const std::string& service, bool on);

 private:
  struct Private;
  std::unique_ptr<Private> _d;
};

}  // namespace ovu
