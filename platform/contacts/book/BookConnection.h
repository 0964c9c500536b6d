/// The phone's address book at Evolution Data Server.
#pragma once

#include <common/Owned.h>
#include <libebook/libebook.h>

#include <chrono>

namespace contacts {

constexpr std::chrono::milliseconds kPatience{5000};

using OwnedBook = common::OwnedObject<EBookClient>;
using OwnedView = common::OwnedObject<EBookClientView>;
using OwnedContact = common::OwnedObject<EContact>;

inline void freeContacts(GSList* contacts) {
  g_slist_free_full(contacts, g_object_unref);
}
using OwnedContacts = common::Owned<GSList, freeContacts>;

/// Null, with a log line, when it cannot be reached in time.
OwnedBook openAddressBook();

/// All contacts, or null when there are none; sets the error when asking failed.
OwnedContacts allContacts(EBookClient* book, GCancellable* cancellable, GError** error);

/// An s-expression that every contact matches.
const char* everybody();

}  // namespace contacts
