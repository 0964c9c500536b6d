// phone-launch [--as CALLER] [--app APPLICATION] [--uri URI] [--mime TYPE] OPERATION
//              [KEY=VALUE...] [KEY[]=VALUE...]
// Sends one launch request and waits until the application has taken it. KEY[] may come several
// times: its values make a text array. An operation without "://" is one of the platform's.

#include <app_control.h>
#include <appfw/CallerName.h>
#include <base/Bus.h>

#include <cstdio>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "Delivery.h"

namespace {

constexpr const char* kViewer = "com.orlant.zelqo";
constexpr const char* kOperations = "http://tizen.org/appcontrol/operation/";
constexpr int kWrongCall = 2;

using Request = common::Owned<app_control_s, app_control_destroy>;

struct Extra {
  std::string key;
  bool isArray;
  std::vector<std::string> values;
};

struct Call {
  std::string caller, application = kViewer, uri, mime, operation;
  std::vector<Extra> extras;
};

int fail(const std::string& why, int status = 1) {
  fprintf(stderr, "phone-launch: %s\n", why.c_str());
  return status;
}

bool addExtra(Call& call, const std::string& word) {
  const size_t equals = word.find('=');
  if (equals == std::string::npos || equals == 0) return false;
  std::string key = word.substr(0, equals);
  const std::string value = word.substr(equals + 1);
  const bool isArray = key.size() > 2 && key.compare(key.size() - 2, 2, "[]") == 0;
  if (isArray) key.resize(key.size() - 2);
  for (auto& extra : call.extras) {
    if (isArray && extra.isArray && extra.key == key) {
      extra.values.push_back(value);
      return true;
    }
  }
  call.extras.push_back({std::move(key), isArray, {value}});
  return true;
}

std::string* option(Call& call, const std::string& name) {
  if (name == "--as") return &call.caller;
  if (name == "--app") return &call.application;
  if (name == "--uri") return &call.uri;
  if (name == "--mime") return &call.mime;
  return nullptr;
}

std::optional<Call> read(int argc, char** argv, std::string& wrong) {
  Call call;
  int i = 1;
  for (; i < argc && argv[i][0] == '-'; i += 2) {
    std::string* value = option(call, argv[i]);
    wrong = std::string("unknown option or no value: ") + argv[i];
    if (!value || i + 1 >= argc) return std::nullopt;
    *value = argv[i + 1];
  }
  wrong = "an operation is missing";
  if (i >= argc) return std::nullopt;
  call.operation = argv[i++];
  if (!call.operation.empty() && call.operation.find("://") == std::string::npos) {
    call.operation.insert(0, kOperations);
  }
  for (; i < argc; i++) {
    wrong = std::string("not KEY=VALUE: ") + argv[i];
    if (!addExtra(call, argv[i])) return std::nullopt;
  }
  return call;
}

int fill(app_control_h request, const Call& call) {
  int error = app_control_set_app_id(request, call.application.c_str());
  if (!error && !call.operation.empty()) {
    error = app_control_set_operation(request, call.operation.c_str());
  }
  if (!error && !call.uri.empty()) error = app_control_set_uri(request, call.uri.c_str());
  if (!error && !call.mime.empty()) error = app_control_set_mime(request, call.mime.c_str());
  for (const auto& extra : call.extras) {
    if (error) return error;
    if (extra.isArray) {
      std::vector<const char*> values;
      for (const auto& value : extra.values) values.push_back(value.c_str());
      error = app_control_add_extra_data_array(request, extra.key.c_str(), values.data(),
                                               static_cast<int>(values.size()));
    } else {
      error = app_control_add_extra_data(request, extra.key.c_str(), extra.values[0].c_str());
    }
  }
  return error;
}

int launch(const Call& call) {
  const common::OwnedBus bus = base::sessionBus();
  if (!bus) return fail("there is no session bus");
  std::unique_ptr<appfw::CallerName> name;
  if (!call.caller.empty()) {
    name = std::make_unique<appfw::CallerName>(call.caller);
    if (!name->isValid()) return fail("cannot act as " + call.caller);
  }
  Request request;
  app_control_create(common::Out(request));
  if (const int error = fill(request.get(), call)) {
    return fail("the request is refused, error " + std::to_string(error));
  }
  Delivery delivery(bus.get());
  const int error = app_control_send_launch_request(request.get(), nullptr, nullptr);
  if (error == APP_CONTROL_ERROR_APP_NOT_FOUND) {
    return fail("there is no application " + call.application);
  }
  if (error) return fail("the launch failed, error " + std::to_string(error));
  std::string reason;
  return delivery.wait(reason) ? 0 : fail(call.application + ": " + reason);
}

}  // namespace

int main(int argc, char** argv) {
  std::string wrong;
  const std::optional<Call> call = read(argc, argv, wrong);
  return call ? launch(*call) : fail(wrong, kWrongCall);
}
