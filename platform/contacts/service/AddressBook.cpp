#include "AddressBook.h"

#include <dlog.h>

#include <utility>

namespace contacts {
namespace {

constexpr guint kReopenAfterMs = 500;
constexpr std::chrono::milliseconds kMoment{500};

template <typename Data>
void connect(EBookClientView* view, const char* signal, GCallback callback, const Data& data) {
  g_signal_connect_data(
      view, signal, callback, new Data(data),
      [](gpointer owned, GClosure*) { delete static_cast<Data*>(owned); },
      static_cast<GConnectFlags>(0));
}

std::shared_ptr<EContact> shared(gpointer contact) {
  return {E_CONTACT(g_object_ref(contact)), g_object_unref};
}

}  // namespace

AddressBook::AddressBook(std::function<void()> onChange) : _onChange(std::move(onChange)) {}

AddressBook::~AddressBook() {
  _close();
  if (_telling) g_source_remove(_telling);
  if (_reopening) g_source_remove(_reopening);
}

void AddressBook::open() {
  _begin();
  if (_opening->isOver(kMoment) && !_install()) _reopenLater();
}

void AddressBook::_begin() {
  _close();
  auto listener = std::make_shared<Listener>();
  listener->owner = this;
  _listener = listener;
  _opening = AddressBookOpening::begin(
      [listener](EBookClientView* view) {
        connect(view, "objects-added", G_CALLBACK(_updatedCb), listener);
        connect(view, "objects-modified", G_CALLBACK(_updatedCb), listener);
        connect(view, "objects-removed", G_CALLBACK(_removedCb), listener);
      },
      [listener] {
        if (listener->owner) listener->owner->_late();
      });
}

bool AddressBook::_install() {
  _open = _opening->take();
  _opening.reset();
  if (!_open) return false;
  g_signal_connect(_open.book.get(), "backend-died", G_CALLBACK(_diedCb), this);
  _persons.clear();
  for (const GSList* item = _open.contacts.get(); item; item = item->next) {
    _put(static_cast<EContact*>(item->data));
  }
  _open.contacts.reset();
  _listener->isOpen = true;
  for (const auto& news : std::exchange(_listener->early, {})) news();
  return true;
}

void AddressBook::_late() {
  if (!_opening) return;
  if (_install()) {
    _changed();
  } else {
    _reopenLater();
  }
}

void AddressBook::_close() {
  if (_listener) _listener->owner = nullptr;
  if (_open.book) g_signal_handlers_disconnect_by_data(_open.book.get(), this);
  _listener.reset();
  _opening.reset();
  _open = {};
}

void AddressBook::_put(EContact* contact) {
  const auto* uid = static_cast<const char*>(e_contact_get_const(contact, E_CONTACT_UID));
  if (!uid) return;
  Person& person = _persons[uid];
  const int id = person.id ? person.id : ++_lastId;
  person = readPerson(contact);
  person.id = id;
}

void AddressBook::Listener::hear(std::function<void()> news) {
  if (!owner) return;
  if (!isOpen) {
    early.push_back(std::move(news));
    return;
  }
  news();
  owner->_changed();
}

void AddressBook::_updatedCb(EBookClientView*, const GSList* contacts, gpointer data) {
  const auto listener = *static_cast<std::shared_ptr<Listener>*>(data);
  for (const GSList* item = contacts; item; item = item->next) {
    listener->hear(
        [self = listener->owner, contact = shared(item->data)] { self->_put(contact.get()); });
  }
}

void AddressBook::_removedCb(EBookClientView*, const GSList* uids, gpointer data) {
  const auto listener = *static_cast<std::shared_ptr<Listener>*>(data);
  for (const GSList* item = uids; item; item = item->next) {
    listener->hear([self = listener->owner, uid = std::string(static_cast<char*>(item->data))] {
      self->_persons.erase(uid);
    });
  }
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
  dlog_print(DLOG_ERROR, "CONTACTS", "the address book went away");
  static_cast<AddressBook*>(data)->_reopenLater();
}

void AddressBook::_reopenLater() {
  if (!_reopening) _reopening = g_timeout_add(kReopenAfterMs, _reopenCb, this);
}

gboolean AddressBook::_reopenCb(gpointer data) {
  auto* self = static_cast<AddressBook*>(data);
  self->_reopening = 0;
  self->_begin();
  return G_SOURCE_REMOVE;
}

}  // namespace contacts
