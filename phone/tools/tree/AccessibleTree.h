// Reads the accessible tree of one application. Many questions are under way at once, and of long
// lists only what can be seen is asked about in full, so that a list of thousands of items takes
// seconds, not minutes. Of more than kMostAtOnce items only the first kSome are there: the toolkit
// cannot send a longer answer.
#pragma once

#include <common/Owned.h>

#include <deque>
#include <functional>
#include <memory>
#include <string>

#include "Widget.h"

class AccessibleTree {
 public:
  explicit AccessibleTree(GDBusConnection* accessibilityBus);
  ~AccessibleTree();
  AccessibleTree(const AccessibleTree&) = delete;
  AccessibleTree& operator=(const AccessibleTree&) = delete;

  static constexpr int kMostAtOnce = 4000, kSome = 1000;

  /// Whether the process has come to the accessibility bus. read() is about that application.
  bool find(int pid);

  /// The application; its children are its windows. Null when it went away meanwhile.
  std::unique_ptr<Widget> read();

 private:
  using Answer = std::function<void(GVariant*)>;
  struct Question;

  void _ask(const Widget& widget, const char* interface, const char* method, GVariant* arguments,
            Answer answer);
  void _send();
  void _askAll(Widget& widget);
  void _askState(Widget& widget);
  void _askName(Widget& widget);
  void _askRest(Widget& widget);
  void _askBriefly(Widget& item);
  void _askChildren(Widget& widget, int count);
  void _addChildren(Widget& widget, GVariant* list);
  int _pidOf(const char* name);
  static void _answeredCb(GObject* bus, GAsyncResult* result, gpointer question);

  GDBusConnection* const _bus;
  const common::OwnedObject<GCancellable> _cancellable;
  std::string _name, _path;
  std::deque<std::unique_ptr<Question>> _waiting;
  int _open = 0;
  bool _failed = false;
};
