#include "AddressBookOpening.h"

#include <base/Deadline.h>
#include <dlog.h>

#include <thread>

namespace contacts {
namespace {

using common::Out;
using common::OwnedError;

OwnedView watch(EBookClient* book, const AddressBookOpening::Connect& connect,
                GCancellable* cancellable, GError** error) {
  OwnedView view;
  OwnedError failure;
  e_book_client_get_view_sync(book, everybody(), Out(view), cancellable, Out(failure));
  if (!failure) {
    e_book_client_view_set_flags(view.get(), E_BOOK_CLIENT_VIEW_FLAGS_NONE, Out(failure));
  }
  if (!failure) {
    connect(view.get());
    e_book_client_view_start(view.get(), Out(failure));
  }
  if (!failure) return view;
  g_propagate_error(error, failure.release());
  return nullptr;
}

/// The watch comes first, so that no change falls between the two.
OpenBook openNow(const AddressBookOpening::Connect& connect) {
  OpenBook result;
  result.book = openAddressBook();
  if (!result.book) return {};
  const base::Deadline deadline(kPatience);
  OwnedError error;
  result.view = watch(result.book.get(), connect, deadline.cancellable(), Out(error));
  if (result.view) {
    result.contacts = allContacts(result.book.get(), deadline.cancellable(), Out(error));
  }
  if (!error) return result;
  dlog_print(DLOG_ERROR, "CONTACTS", "the address book cannot be read: %s", error->message);
  return {};
}

}  // namespace

/// The thread may outlive everybody who waits: a service that does not answer ends it late.
std::shared_ptr<AddressBookOpening> AddressBookOpening::begin(Connect connect,
                                                              std::function<void()> over) {
  auto opening = std::make_shared<AddressBookOpening>();
  opening->_connect = std::move(connect);
  opening->_over = std::move(over);
  std::thread([opening] { opening->run(); }).detach();
  return opening;
}

void AddressBookOpening::run() {
  OpenBook result = openNow(_connect);
  {
    const std::lock_guard<std::mutex> lock(_mutex);
    _result = std::move(result);
    _isOver = true;
  }
  _changed.notify_all();
  g_idle_add_full(G_PRIORITY_DEFAULT, overCb, new std::function<void()>(std::move(_over)),
                  deleteCb);
}

gboolean AddressBookOpening::overCb(gpointer over) {
  (*static_cast<std::function<void()>*>(over))();
  return G_SOURCE_REMOVE;
}

void AddressBookOpening::deleteCb(gpointer over) {
  delete static_cast<std::function<void()>*>(over);
}

bool AddressBookOpening::isOver(std::chrono::milliseconds patience) {
  std::unique_lock<std::mutex> lock(_mutex);
  return _changed.wait_for(lock, patience, [this] { return _isOver; });
}

OpenBook AddressBookOpening::take() {
  const std::lock_guard<std::mutex> lock(_mutex);
  return std::move(_result);
}

}  // namespace contacts
