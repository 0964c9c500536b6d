#include "AccessibleTree.h"

using common::Out;
using common::OwnedError;
using common::OwnedVariant;

namespace {

constexpr const char* kAccessible = "org.a11y.atspi.Accessible";
constexpr const char* kComponent = "org.a11y.atspi.Component";
constexpr const char* kProperties = "org.freedesktop.DBus.Properties";
constexpr const char* kRegistry = "org.a11y.atspi.Registry";
constexpr const char* kRoot = "/org/a11y/atspi/accessible/root";
constexpr guint32 kScreenCoordinates = 0;
constexpr int kTimeoutMs = 5000;
constexpr int kMostOpen = 100;     // questions under way: more would wait longer than kTimeoutMs
constexpr size_t kLongList = 100;  // items

void readStates(Widget& widget, GVariant* answer) {
  const OwnedVariant words(g_variant_get_child_value(answer, 0));
  if (!g_variant_is_of_type(words.get(), G_VARIANT_TYPE("au"))) return;
  gsize count = 0;
  const auto* values =
      static_cast<const guint32*>(g_variant_get_fixed_array(words.get(), &count, sizeof(guint32)));
  if (count > 0) widget.states = values[0];
  if (count > 1) widget.states |= static_cast<uint64_t>(values[1]) << 32;
}

int readCount(GVariant* answer) {
  const OwnedVariant boxed(g_variant_get_child_value(answer, 0));
  if (!g_variant_is_of_type(boxed.get(), G_VARIANT_TYPE_VARIANT)) return 0;
  const OwnedVariant count(g_variant_get_variant(boxed.get()));
  return g_variant_is_of_type(count.get(), G_VARIANT_TYPE_INT32) ? g_variant_get_int32(count.get())
                                                                 : 0;
}

void readName(Widget& widget, GVariant* answer) {
  const OwnedVariant boxed(g_variant_get_child_value(answer, 0));
  if (!g_variant_is_of_type(boxed.get(), G_VARIANT_TYPE_VARIANT)) return;
  const OwnedVariant name(g_variant_get_variant(boxed.get()));
  if (g_variant_is_of_type(name.get(), G_VARIANT_TYPE_STRING)) {
    widget.name = g_variant_get_string(name.get(), nullptr);
  }
}

void readArea(Widget& widget, GVariant* answer) {
  if (!g_variant_is_of_type(answer, G_VARIANT_TYPE("((iiii))"))) return;
  g_variant_get(answer, "((iiii))", &widget.area.x, &widget.area.y, &widget.area.width,
                &widget.area.height);
  if (widget.area.width < 0 || widget.area.height < 0) widget.area = {};  // not laid out yet
  widget.hasArea = true;
}

void readRole(Widget& widget, GVariant* answer) {
  if (g_variant_is_of_type(answer, G_VARIANT_TYPE("(s)"))) {
    const char* role = nullptr;
    g_variant_get(answer, "(&s)", &role);
    widget.role = role;
  }
}

}  // namespace

struct AccessibleTree::Question {
  AccessibleTree* tree;
  const Widget* widget;
  const char *interface, *method;
  OwnedVariant arguments;
  Answer answer;
};

AccessibleTree::AccessibleTree(GDBusConnection* accessibilityBus)
    : _bus(accessibilityBus), _cancellable(g_cancellable_new()) {}

AccessibleTree::~AccessibleTree() {
  g_cancellable_cancel(_cancellable.get());
}

bool AccessibleTree::find(int pid) {
  const OwnedVariant answer(g_dbus_connection_call_sync(
      _bus, kRegistry, kRoot, kAccessible, "GetChildren", nullptr, G_VARIANT_TYPE("(a(so))"),
      G_DBUS_CALL_FLAGS_NONE, kTimeoutMs, nullptr, nullptr));
  if (!answer) return false;
  const OwnedVariant list(g_variant_get_child_value(answer.get(), 0));
  GVariantIter applications;
  g_variant_iter_init(&applications, list.get());
  const char *name = nullptr, *path = nullptr;
  while (g_variant_iter_next(&applications, "(&s&o)", &name, &path)) {
    if (_pidOf(name) != pid) continue;
    _name = name;
    _path = path;
    return true;
  }
  return false;
}

int AccessibleTree::_pidOf(const char* name) {
  const OwnedVariant answer(g_dbus_connection_call_sync(
      _bus, "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "GetConnectionUnixProcessID", g_variant_new("(s)", name), G_VARIANT_TYPE("(u)"),
      G_DBUS_CALL_FLAGS_NONE, kTimeoutMs, nullptr, nullptr));
  guint32 pid = 0;
  if (answer) g_variant_get(answer.get(), "(u)", &pid);
  return static_cast<int>(pid);
}

std::unique_ptr<Widget> AccessibleTree::read() {
  auto root = std::make_unique<Widget>();
  root->bus = _name;
  root->path = _path;
  _failed = false;
  _askAll(*root);
  while (_open > 0) g_main_context_iteration(nullptr, TRUE);
  if (_failed) return nullptr;
  return root;
}

void AccessibleTree::_askAll(Widget& widget) {
  _askState(widget);
  _askName(widget);
  _askRest(widget);
}

void AccessibleTree::_askState(Widget& widget) {
  _ask(widget, kAccessible, "GetState", nullptr,
       [&widget](GVariant* answer) { readStates(widget, answer); });
}

void AccessibleTree::_askName(Widget& widget) {
  _ask(widget, kProperties, "Get", g_variant_new("(ss)", kAccessible, "Name"),
       [&widget](GVariant* answer) { readName(widget, answer); });
}

void AccessibleTree::_askRest(Widget& widget) {
  _ask(widget, kAccessible, "GetRoleName", nullptr,
       [&widget](GVariant* answer) { readRole(widget, answer); });
  _ask(widget, kComponent, "GetExtents", g_variant_new("(u)", kScreenCoordinates),
       [&widget](GVariant* answer) { readArea(widget, answer); });
  _ask(widget, kProperties, "Get", g_variant_new("(ss)", kAccessible, "ChildCount"),
       [this, &widget](GVariant* answer) { _askChildren(widget, readCount(answer)); });
}

void AccessibleTree::_askChildren(Widget& widget, int count) {
  if (count <= kMostAtOnce) {
    _ask(widget, kAccessible, "GetChildren", nullptr,
         [this, &widget](GVariant* answer) { _addChildren(widget, answer); });
    return;
  }
  for (int i = 0; i < kSome; i++) {
    widget.children.push_back(std::make_unique<Widget>());
    Widget& child = *widget.children.back();
    _ask(widget, kAccessible, "GetChildAtIndex", g_variant_new("(i)", i),
         [this, &child](GVariant* answer) {
           if (!g_variant_is_of_type(answer, G_VARIANT_TYPE("((so))"))) return;
           const char *name = nullptr, *path = nullptr;
           g_variant_get(answer, "((&s&o))", &name, &path);
           child.bus = name;
           child.path = path;
           _askBriefly(child);
         });
  }
}

/// An item of a long list: in full only when it can be seen.
void AccessibleTree::_askBriefly(Widget& item) {
  item.role = "list item";
  item.hasArea = true;
  _askName(item);
  _ask(item, kAccessible, "GetState", nullptr, [this, &item](GVariant* answer) {
    readStates(item, answer);
    if (item.is("showing")) _askRest(item);
  });
}

void AccessibleTree::_addChildren(Widget& widget, GVariant* answer) {
  if (!g_variant_is_of_type(answer, G_VARIANT_TYPE("(a(so))"))) return;
  const OwnedVariant list(g_variant_get_child_value(answer, 0));
  GVariantIter children;
  g_variant_iter_init(&children, list.get());
  const char *name = nullptr, *path = nullptr;
  while (g_variant_iter_next(&children, "(&s&o)", &name, &path)) {
    auto child = std::make_unique<Widget>();
    child->bus = name;
    child->path = path;
    widget.children.push_back(std::move(child));
  }
  const bool isLong = widget.children.size() > kLongList && widget.is("manages-descendants");
  for (const auto& child : widget.children) {
    if (isLong) {
      _askBriefly(*child);
    } else {
      _askAll(*child);
    }
  }
}

void AccessibleTree::_ask(const Widget& widget, const char* interface, const char* method,
                          GVariant* arguments, Answer answer) {
  OwnedVariant owned(arguments ? g_variant_ref_sink(arguments) : nullptr);
  _waiting.emplace_back(
      new Question{this, &widget, interface, method, std::move(owned), std::move(answer)});
  _send();
}

void AccessibleTree::_send() {
  while (_open < kMostOpen && !_waiting.empty()) {
    Question* const question = _waiting.front().release();
    _waiting.pop_front();
    _open++;
    g_dbus_connection_call(_bus, question->widget->bus.c_str(), question->widget->path.c_str(),
                           question->interface, question->method, question->arguments.get(),
                           nullptr, G_DBUS_CALL_FLAGS_NO_AUTO_START, kTimeoutMs, _cancellable.get(),
                           _answeredCb, question);
  }
}

void AccessibleTree::_answeredCb(GObject* bus, GAsyncResult* result, gpointer data) {
  const std::unique_ptr<Question> question(static_cast<Question*>(data));
  OwnedError error;
  const OwnedVariant answer(
      g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, Out(error)));
  question->tree->_open--;
  if (answer) {
    question->answer(answer.get());
  } else if (g_error_matches(error.get(), G_DBUS_ERROR, G_DBUS_ERROR_NO_REPLY) ||
             g_error_matches(error.get(), G_DBUS_ERROR, G_DBUS_ERROR_SERVICE_UNKNOWN) ||
             g_error_matches(error.get(), G_DBUS_ERROR, G_DBUS_ERROR_NAME_HAS_NO_OWNER)) {
    question->tree->_failed = true;
    question->tree->_waiting.clear();
  }  // else the widget has gone, or is of a kind that does not know the answer
  question->tree->_send();
}
