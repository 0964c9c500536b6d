/// All persons of the address book, as the phone's contacts service tells them: asked for once,
/// then kept current.
#pragma once

#include <base/Bus.h>

#include <functional>
#include <memory>
#include <vector>

#include "Person.h"

namespace contacts {

class PersonIndex {
 public:
  /// Called on the main loop after the index has changed.
  explicit PersonIndex(std::function<void()> onChange);
  ~PersonIndex();
  PersonIndex(const PersonIndex&) = delete;
  PersonIndex& operator=(const PersonIndex&) = delete;

  /// Waits a moment for the service; when it needs longer or is away, its persons come later, which
  /// is a change. False when there is no bus to ask on.
  bool open();

  const std::vector<Person>& persons() const { return _persons; }

 private:
  static void _changedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                         GVariant*, gpointer self);
  static void _fetchedCb(GObject* bus, GAsyncResult* result, gpointer self);

  void _fetch();

  const std::function<void()> _onChange;
  std::unique_ptr<base::SignalSubscription> _changes;
  common::OwnedObject<GCancellable> _fetching;  ///< null when nothing is under way
  bool _isOutdated = false;  ///< what is under way may be older than the last change
  std::vector<Person> _persons;
};

}  // namespace contacts
