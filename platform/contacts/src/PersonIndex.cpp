#include "PersonIndex.h"

#include <dlog.h>

#include <climits>
#include <utility>

namespace contacts {

using common::Out;
using common::OwnedBus;
using common::OwnedError;
using common::OwnedVariant;

PersonIndex::PersonIndex(std::function<void()> onChange) : _onChange(std::move(onChange)) {}

PersonIndex::~PersonIndex() {
  if (_fetching) g_cancellable_cancel(_fetching.get());
}

/// The watch comes first, so that no change falls between the two.
bool PersonIndex::open() {
  const OwnedBus bus = base::sessionBus();
  if (!bus) return false;
  _changes = std::make_unique<base::SignalSubscription>(
      base::BusKind::Session,
      base::SignalSubscription::Match{nullptr, kServiceInterface, "Changed", kServicePath},
      _changedCb, this);
  const OwnedVariant persons = base::ask(
      bus.get(), {kServiceName, kServicePath, kServiceInterface, "GetAll", nullptr, kPersonsType});
  if (persons) {
    _persons = fromVariant(persons.get());
  } else {
    dlog_print(DLOG_ERROR, "CONTACTS", "the contacts service does not answer");
    _fetch();
  }
  return true;
}

void PersonIndex::_changedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                             GVariant*, gpointer self) {
  static_cast<PersonIndex*>(self)->_fetch();
}

void PersonIndex::_fetch() {
  if (_fetching) {
    _isOutdated = true;
    return;
  }
  const OwnedBus bus = base::sessionBus();
  if (!bus) return;
  _fetching.reset(g_cancellable_new());
  g_dbus_connection_call(bus.get(), kServiceName, kServicePath, kServiceInterface, "GetAll",
                         nullptr, G_VARIANT_TYPE(kPersonsType), G_DBUS_CALL_FLAGS_NO_AUTO_START,
                         INT_MAX, _fetching.get(), _fetchedCb, this);
}

/// A service that has gone says that there are changes when it is back.
void PersonIndex::_fetchedCb(GObject* bus, GAsyncResult* result, gpointer data) {
  OwnedError error;
  const OwnedVariant persons(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, Out(error)));
  if (g_error_matches(error.get(), G_IO_ERROR, G_IO_ERROR_CANCELLED)) return;
  auto* self = static_cast<PersonIndex*>(data);
  self->_fetching.reset();
  if (persons) self->_persons = fromVariant(persons.get());
  if (std::exchange(self->_isOutdated, false)) self->_fetch();
  if (persons) self->_onChange();  // last: it may close the index
}

}  // namespace contacts
