// Reads the accessible tree of one application. All questions that can be asked at once are asked
// at once, so that a list of thousands of items takes a few round trips.
#pragma once

#include <base/Owned.h>

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

  /// Whether the process has come to the accessibility bus. read() is about that application.
  bool find(int pid);

  /// The application; its children are its windows. Null when it went away meanwhile.
  std::unique_ptr<Widget> read();

 private:
  using Answer = std::function<void(GVariant*)>;
  struct Question;

  void _ask(const Widget& widget, const char* interface, const char* method, GVariant* arguments,
            Answer answer);
  void _askAll(Widget& widget);
  void _addChildren(Widget& widget, GVariant* list);
  int _pidOf(const char* name);
  static void _answeredCb(GObject* bus, GAsyncResult* result, gpointer question);

  GDBusConnection* const _bus;
  const base::Owned<GCancellable, g_object_unref> _cancellable;
  std::string _name, _path;
  int _open = 0;
  bool _failed = false;
};
