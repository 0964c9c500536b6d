#include "AddressBook.h"

#include <dlog.h>

#include "Deadline.h"

namespace contacts {

using common::Out;
using common::OwnedError;

constexpr guint kReopenAfterMs = 500;

AddressBook::AddressBook(std::function<void()> onChange) : _onChange(std::move(onChange)) {}

AddressBook::~AddressBook() {
  _close();
  if (_telling) g_source_remove(_telling);
  if (_reopening) g_source_remove(_reopening);
}

bool AddressBook::open() {
  _close();
  _book = openAddressBook();
  if (!_book) return false;
  g_signal_connect(_book.get(), "backend-died", G_CALLBACK(_diedCb), this);
  const Deadline deadline(kPatience);
  OwnedError error;
  OwnedContacts contacts;
  // The watch comes first, so that no change falls between the two.
  if (_watch(deadline.cancellable(), Out(error))) {
    contacts = allContacts(_book.get(), deadline.cancellable(), Out(error));
  }
  if (error) {
    dlog_print(DLOG_ERROR, "CONTACTS", "the address book cannot be read: %s", error->message);
    _close();
    return false;
  }
  _persons.clear();
  for (const GSList* item = contacts.get(); item; item = item->next) {
    _put(static_cast<EContact*>(item->data));
  }
  return true;
}

bool AddressBook::_watch(GCancellable* cancellable, GError** error) {
  OwnedError failure;
  e_book_client_get_view_sync(_book.get(), everybody(), Out(_view), cancellable, Out(failure));
  if (!failure) {
    e_book_client_view_set_flags(_view.get(), E_BOOK_CLIENT_VIEW_FLAGS_NONE, Out(failure));
  }
  if (!failure) {
    g_signal_connect(_view.get(), "objects-added", G_CALLBACK(_updatedCb), this);
    g_signal_connect(_view.get(), "objects-modified", G_CALLBACK(_updatedCb), this);
    g_signal_connect(_view.get(), "objects-removed", G_CALLBACK(_removedCb), this);
    e_book_client_view_start(_view.get(), Out(failure));
  }
  if (!failure) return true;
  g_propagate_error(error, failure.release());
  return false;
}

void AddressBook::_close() {
  if (_view) {
    g_signal_handlers_disconnect_by_data(_view.get(), this);
    e_book_client_view_stop(_view.get(), nullptr);
  }
  if (_book) g_signal_handlers_disconnect_by_data(_book.get(), this);
  _view.reset();
  _book.reset();
}

void AddressBook::_put(EContact* contact) {
  const auto* uid = static_cast<const char*>(e_contact_get_const(contact, E_CONTACT_UID));
  if (!uid) return;
  Person& person = _persons[uid];
  const int id = person.id ? person.id : ++_lastId;
  person = readPerson(contact);
  person.id = id;
}

void AddressBook::_updatedCb(EBookClientView*, const GSList* contacts, gpointer data) {
  auto* self = static_cast<AddressBook*>(data);
  for (const GSList* item = contacts; item; item = item->next) {
    self->_put(static_cast<EContact*>(item->data));
  }
  self->_changed();
}

void AddressBook::_removedCb(EBookClientView*, const GSList* uids, gpointer data) {
  auto* self = static_cast<AddressBook*>(data);
  for (const GSList* item = uids; item; item = item->next) {
    self->_persons.erase(static_cast<const char*>(item->data));
  }
  self->_changed();
}

void AddressBook::_changed() {
  if (!_telling) _telling = g_idle_add(_tellCb, this);
}

gboolean AddressBook::_tellCb(gpointer data) {
  auto* self = static_cast<AddressBook*>(data);
  self->_telling = 0;
  self->_onChange();  // may close the address book
  return G_SOURCE_REMOVE;
}

/// The service that holds the address book crashed; it is started again by being asked.
void AddressBook::_diedCb(EClient*, gpointer data) {
  auto* self = static_cast<AddressBook*>(data);
  dlog_print(DLOG_ERROR, "CONTACTS", "the address book went away");
  if (!self->_reopening) self->_reopening = g_timeout_add(kReopenAfterMs, _reopenCb, self);
}

gboolean AddressBook::_reopenCb(gpointer data) {
  auto* self = static_cast<AddressBook*>(data);
  self->_reopening = 0;
  if (self->open()) self->_changed();
  return G_SOURCE_REMOVE;
}

}  // namespace contacts
