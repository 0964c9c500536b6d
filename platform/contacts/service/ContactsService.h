/// The phone's contacts on the session bus: one process reads the address book, for all
/// applications.
#pragma once

#include <common/Owned.h>

#include "AddressBook.h"

namespace contacts {

class ContactsService {
 public:
  explicit ContactsService(GDBusConnection* bus);
  ~ContactsService();
  ContactsService(const ContactsService&) = delete;
  ContactsService& operator=(const ContactsService&) = delete;

  /// Waits a moment for the address book before it begins to answer. False, with a log line, when
  /// there is another one.
  bool start();

 private:
  static void _methodCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                        GVariant*, GDBusMethodInvocation* invocation, gpointer self);

  void _tellChange();

  GDBusConnection* const _bus;
  AddressBook _book;
  guint _object = 0;
};

}  // namespace contacts
