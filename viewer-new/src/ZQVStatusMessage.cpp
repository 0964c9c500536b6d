#include "ZQVStatusMessage.h"

#include <notification.h>

#include "ZQVText.h"

void zqvPostStatusMessage(const char* id) {
  notification_status_message_post(zqvText(id));
}
