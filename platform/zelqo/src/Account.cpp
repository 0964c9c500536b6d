#include "zelqo/Account.h"

#include <utility>

#include "ServiceClient.h"
#include "zelqo/PhoneSettings.h"

namespace zelqo {
namespace {

constexpr guint kDeadlineMs = 15000;

std::string credentials(const std::string& msisdn, const std::string& imsi) {
  common::JsonWriter json;
  return json.open().text("msisdn", msisdn).text("imsi", imsi).close().str();
}

std::string textOf(const ServiceClient::Reply& reply, const char* member) {
  const common::JsonTree json = reply.error ? nullptr : reply.json();
  const auto text =
      json ? common::textMember(json_node_get_object(json.get()), member) : std::nullopt;
  return text.value_or("");
}

void answerSharing(const ServiceClient::Reply& reply, const Account::SharingCb& done) {
  const std::string status = textOf(reply, "status");
  const int error = !reply.error && status.empty() ? ZELQO_ERROR_REFUSED : reply.error;
  done(error, status == "on");
}

}  // namespace

Account::Account(Store& store, std::string msisdn, const std::string& serviceUrl)
    : _store(store),
      _msisdn(std::move(msisdn)),
      _client(std::make_unique<ServiceClient>(serviceUrl.empty() ? zelqo::serviceUrl() : serviceUrl,
                                              kDeadlineMs)) {}

Account::~Account() = default;

bool Account::signedUp() {
  return !_store.accessKey(_msisdn).empty();
}

std::string Account::servicePath() const {
  return "/v1/subscribers/" + _msisdn + "/services/2";
}

void Account::signUp(const std::string& imsi, const SignedUpCb& done) {
  ServiceClient::Request request;
  request.method = "POST";
  request.path = "/v1/subscribers";
  request.json = credentials(_msisdn, imsi);
  const bool sent = _client->send(request, [this, done](const ServiceClient::Reply& reply) {
    int error = reply.error;
    const std::string key = textOf(reply, "key");
    if (!error && key.empty()) error = ZELQO_ERROR_REFUSED;
    if (!error && !_store.setAccessKey(_msisdn, key)) error = ZELQO_ERROR_STORE;
    done(error);
  });
  if (!sent) done(ZELQO_ERROR_NETWORK);
}

void Account::querySharing(const SharingCb& done) {
  ServiceClient::Request request;
  request.path = servicePath();
  request.key = _store.accessKey(_msisdn);
  const bool sent = _client->send(
      request, [done](const ServiceClient::Reply& reply) { answerSharing(reply, done); });
  if (!sent) done(ZELQO_ERROR_NETWORK, false);
}

void Account::switchSharing(bool on, const SharingCb& done) {
  ServiceClient::Request request;
  request.method = "PUT";
  request.path = servicePath();
  request.key = _store.accessKey(_msisdn);
  request.json = on ? R"({"status":"on"})" : R"({"status":"off"})";
  const bool sent = _client->send(
      request, [done](const ServiceClient::Reply& reply) { answerSharing(reply, done); });
  if (!sent) done(ZELQO_ERROR_NETWORK, false);
}

}  // namespace zelqo
