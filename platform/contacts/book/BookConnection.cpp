#include "BookConnection.h"

#include <base/Deadline.h>
#include <dlog.h>

namespace contacts {

using common::Out;
using common::OwnedError;
using common::OwnedObject;

constexpr guint32 kDoNotWaitForOnline = static_cast<guint32>(-1);

OwnedBook openAddressBook() {
  const base::Deadline deadline(kPatience);
  OwnedError error;
  const OwnedObject<ESourceRegistry> registry(
      e_source_registry_new_sync(deadline.cancellable(), Out(error)));
  if (registry) {
    const OwnedObject<ESource> source(e_source_registry_ref_default_address_book(registry.get()));
    EClient* client = e_book_client_connect_sync(source.get(), kDoNotWaitForOnline,
                                                 deadline.cancellable(), Out(error));
    if (client) return OwnedBook(E_BOOK_CLIENT(client));
  }
  dlog_print(DLOG_ERROR, "CONTACTS", "no address book: %s", error ? error->message : "unknown");
  return nullptr;
}

const char* everybody() {
  return "(contains \"x-evolution-any-field\" \"\")";
}

OwnedContacts allContacts(EBookClient* book, GCancellable* cancellable, GError** error) {
  OwnedContacts contacts;
  e_book_client_get_contacts_sync(book, everybody(), Out(contacts), cancellable, error);
  return contacts;
}

}  // namespace contacts
