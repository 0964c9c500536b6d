#include <memory>
#include <string>

#include "ServiceClient.h"
#include "ShareBook.h"
#include "transfers.h"
#include "zelqo/PhoneSettings.h"

namespace {

// The user is told after a minute that it did not work; an answer after that helps nobody.
constexpr guint kDeadlineMs = 55000;

// One recall on its way; ends itself with its answer.
class Recall {
 public:
  Recall(std::string token, zelqo_recall_cb callback, void* userData)
      : _client(zelqo::serviceUrl(), kDeadlineMs),
        _token(std::move(token)),
        _callback(callback),
        _userData(userData) {}

  bool send(unsigned int requestId, const std::string& key) {
    zelqo::ServiceClient::Request request;
    request.method = "POST";
    request.path = "/v1/shares/" + std::to_string(requestId) + "/recall";
    request.key = key;
    return _client.send(request, [this](const zelqo::ServiceClient::Reply& reply) {
      const std::unique_ptr<Recall> self(this);
      answered(reply);
    });
  }

 private:
  void answered(const zelqo::ServiceClient::Reply& reply) {
    if (reply.error) {
      g_warning("zelqo: not recalled: %s", reply.reason.c_str());
    } else {
      zelqo::ShareBook::instance().store().markRecalled(_token, g_get_real_time() / 1000);
    }
    _callback(reply.error, _userData);
  }

  zelqo::ServiceClient _client;
  std::string _token;
  zelqo_recall_cb _callback;
  void* _userData;
};

}  // namespace

int zelqo_transfer_recall(unsigned int request_id, zelqo_recall_cb callback, void* user_data) {
  if (!callback) return ZELQO_ERROR_INVALID_PARAMETER;
  zelqo::Store& store = zelqo::ShareBook::instance().store();
  const auto share = store.sent(request_id);
  if (!share) return ZELQO_ERROR_NO_DATA;
  const std::string key = store.accessKey(share->sender);
  if (key.empty()) return ZELQO_ERROR_NO_DATA;
  auto recall = std::make_unique<Recall>(share->token, callback, user_data);
  if (!recall->send(request_id, key)) return ZELQO_ERROR_NETWORK;
  static_cast<void>(recall.release());  // its answer owns it
  return ZELQO_ERROR_NONE;
}
