/// Opens the address book beside the main loop: its service may take long, or not answer at all.
#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>

#include "BookConnection.h"

namespace contacts {

struct OpenBook {
  OwnedBook book;
  OwnedView view;
  OwnedContacts contacts;  ///< when the view began; what changed since then the view has told

  explicit operator bool() const { return view != nullptr; }
};

class AddressBookOpening {
 public:
  /// Runs in a thread of its own and gives the view its listeners before it is started.
  using Connect = std::function<void(EBookClientView*)>;

  /// `over` runs on the main loop after the end, whether or not somebody waited for it.
  static std::shared_ptr<AddressBookOpening> begin(Connect connect, std::function<void()> over);

  /// Whether it has come to an end, well or not, within that time.
  bool isOver(std::chrono::milliseconds patience);
  /// What was opened; nothing, with a log line, when it failed. Once.
  OpenBook take();

 private:
  void run();
  static gboolean overCb(gpointer over);
  static void deleteCb(gpointer over);

  Connect _connect;
  std::function<void()> _over;
  std::mutex _mutex;
  std::condition_variable _changed;
  bool _isOver = false;
  OpenBook _result;
};

}  // namespace contacts
