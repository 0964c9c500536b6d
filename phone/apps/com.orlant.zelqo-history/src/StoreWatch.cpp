#include "StoreWatch.h"

#include <base/PhonePaths.h>

#include <cstring>

namespace history {
namespace {

constexpr double kBurstSeconds = 0.1;
constexpr const char* kStore = "zelqo.db";

common::OwnedObject<GFileMonitor> watchFolder(const std::string& folder) {
  const common::OwnedObject<GFile> file(g_file_new_for_path(folder.c_str()));
  return common::OwnedObject<GFileMonitor>(
      g_file_monitor_directory(file.get(), G_FILE_MONITOR_NONE, nullptr, nullptr));
}

// The store itself or its write-ahead log. Its index changes with mere reading, ours included.
bool isOfStore(GFile* file) {
  const common::OwnedText name(g_file_get_basename(file));
  return std::strcmp(name.get(), kStore) == 0 ||
         std::string(name.get()) == std::string(kStore) + "-wal";
}

}  // namespace

StoreWatch::StoreWatch(std::function<void()> onChange)
    : _onChange(std::move(onChange)),
      _monitor(watchFolder(base::databaseFolder())),
      _recalled(base::BusKind::System,
                {nullptr, "org.tizen.call.remote.share", "recall", "/com/orlant/remoteshare"},
                _recalledCb, this) {
  if (_monitor) g_signal_connect(_monitor.get(), "changed", G_CALLBACK(_writtenCb), this);
}

StoreWatch::~StoreWatch() {
  if (_monitor) g_signal_handlers_disconnect_by_data(_monitor.get(), this);
  if (_timer) ecore_timer_del(_timer);
}

void StoreWatch::_writtenCb(GFileMonitor*, GFile* file, GFile*, GFileMonitorEvent event,
                            gpointer data) {
  const bool isWritten = event == G_FILE_MONITOR_EVENT_CHANGED ||
                         event == G_FILE_MONITOR_EVENT_CREATED ||
                         event == G_FILE_MONITOR_EVENT_DELETED;
  if (isWritten && isOfStore(file)) static_cast<StoreWatch*>(data)->_changed();
}

void StoreWatch::_recalledCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                             GVariant*, void* data) {
  static_cast<StoreWatch*>(data)->_changed();
}

void StoreWatch::_changed() {
  if (!_timer) _timer = ecore_timer_add(kBurstSeconds, _timerCb, this);
}

Eina_Bool StoreWatch::_timerCb(void* data) {
  auto* watch = static_cast<StoreWatch*>(data);
  watch->_timer = nullptr;
  watch->_onChange();
  return ECORE_CALLBACK_CANCEL;
}

}  // namespace history
