/// The index of the address book: read once, then kept up to date by the address book's own
/// notifications.
#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "BookConnection.h"
#include "Person.h"

namespace contacts {

class AddressBook {
 public:
  /// Called on the main loop after the index has changed, once for many changes.
  explicit AddressBook(std::function<void()> onChange);
  ~AddressBook();
  AddressBook(const AddressBook&) = delete;
  AddressBook& operator=(const AddressBook&) = delete;

  /// False, with a log line, when the address book cannot be reached.
  bool open();

  /// By the address book's own ids.
  const std::map<std::string, Person>& persons() const { return _persons; }

 private:
  static void _updatedCb(EBookClientView*, const GSList* contacts, gpointer self);
  static void _removedCb(EBookClientView*, const GSList* uids, gpointer self);
  static void _diedCb(EClient*, gpointer self);
  static gboolean _tellCb(gpointer self);
  static gboolean _reopenCb(gpointer self);

  bool _watch(GCancellable* cancellable, GError** error);
  void _close();
  void _put(EContact* contact);
  void _changed();

  using OwnedView = common::Owned<EBookClientView, g_object_unref>;

  const std::function<void()> _onChange;
  OwnedBook _book;
  OwnedView _view;
  std::map<std::string, Person> _persons;
  int _lastId = 0;
  guint _telling = 0;
  guint _reopening = 0;
};

}  // namespace contacts
