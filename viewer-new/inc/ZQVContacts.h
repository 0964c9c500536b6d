#pragma once

#include <stdint.h>
#include <zelqo.h>

#include <string>

#include "ZQVCommon.h"

/// The pictures that stand for people without one.
#define ZQV_DEFAULT_CALLER_IMAGE ZQV_IMAGE_DIR "contacts_caller_id_default_02.png"
#define ZQV_GROUP_CALLER_IMAGE ZQV_IMAGE_DIR "zq_caller_id_default_group.png"

/// People by phone number, as the phone's contacts know them.
class ZQVContacts {
 public:
  /// The display name as a new text, freed with g_free; null when nobody is found.
  static char* _getContactName(const char* number);
  /// The path of the picture, empty when there is none.
  static std::string _getContactImagePath(const char* number);

  /// The display name, or the number itself.
  static std::string nameOrNumber(const char* number);
  /// The display names or numbers, joined with ",".
  static std::string recipientsText(zelqo_recipient_s** recipients, uint32_t count);
  /// The group picture for several, else the one person's picture or its default.
  static std::string recipientsImage(zelqo_recipient_s** recipients, uint32_t count);
};
