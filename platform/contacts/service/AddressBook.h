/// The index of the address book: read once, then kept up to date by the address book's own
/// notifications.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "AddressBookOpening.h"
#include "PersonReader.h"

namespace contacts {

class AddressBook {
 public:
  /// Called on the main loop after the index has changed, once for many changes.
  explicit AddressBook(std::function<void()> onChange);
  ~AddressBook();
  AddressBook(const AddressBook&) = delete;
  AddressBook& operator=(const AddressBook&) = delete;

  /// Waits a moment for the address book; one that needs longer, or cannot be read now, comes
  /// later, which is a change.
  void open();

  /// By the address book's own ids.
  const std::map<std::string, Person>& persons() const { return _persons; }

 private:
  /// Where the address book's notifications arrive, until it is closed.
  struct Listener {
    AddressBook* owner;
    std::vector<std::function<void()>> early;  ///< came before the index that they change
    bool isOpen = false;

    void hear(std::function<void()> news);
  };

  static void _updatedCb(EBookClientView*, const GSList* contacts, gpointer listener);
  static void _removedCb(EBookClientView*, const GSList* uids, gpointer listener);
  static void _diedCb(EClient*, gpointer self);
  static gboolean _tellCb(gpointer self);
  static gboolean _reopenCb(gpointer self);

  void _begin();
  bool _install();
  void _late();
  void _close();
  void _reopenLater();
  void _put(EContact* contact);
  void _changed();

  const std::function<void()> _onChange;
  std::shared_ptr<AddressBookOpening> _opening;
  std::shared_ptr<Listener> _listener;
  OpenBook _open;
  std::map<std::string, Person> _persons;
  int _lastId = 0;
  guint _telling = 0;
  guint _reopening = 0;
};

}  // namespace contacts
