/// The receiving end of launch requests: the application on the session bus.
#pragma once

#include <app_control.h>
#include <base/Bus.h>

#include <deque>
#include <functional>
#include <memory>
#include <string>

namespace appfw {

class AppService {
 public:
  /// The handle is the service's and valid only during the call.
  using RequestHandler = std::function<void(app_control_h)>;

  explicit AppService(std::string appId);
  ~AppService();
  AppService(const AppService&) = delete;
  AppService& operator=(const AppService&) = delete;

  /// Takes the application's name, so call it before anything slow: whoever launches the
  /// application waits for the name. False when another process has it or there is no bus.
  /// `onNameLost` runs when this process is no longer the application and has to end.
  bool start(std::function<void()> onNameLost);

  /// From now on requests go to `handler`, in the order of arrival and from the default main
  /// context; first those that came before.
  void deliverTo(RequestHandler handler);

 private:
  static void methodCb(GDBusConnection* bus, const char* sender, const char* path,
                       const char* interface, const char* method, GVariant* arguments,
                       GDBusMethodInvocation* invocation, void* data);
  static void nameLostCb(GDBusConnection* bus, const char* sender, const char* path,
                         const char* interface, const char* signal, GVariant* arguments,
                         void* data);
  static gboolean deliverCb(void* data);

  void launch(const char* sender, GVariant* arguments, GDBusMethodInvocation* invocation);
  void deliverSoon();
  void deliverNext();

  using Request = common::Owned<app_control_s, app_control_destroy>;

  const std::string _appId;
  common::OwnedBus _bus;
  unsigned _object = 0;
  unsigned _idle = 0;
  bool _named = false;
  std::function<void()> _onNameLost;
  RequestHandler _handler;
  std::deque<Request> _waiting;
  std::unique_ptr<base::SignalSubscription> _nameLost;
};

}  // namespace appfw
