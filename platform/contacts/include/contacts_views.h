/// The views of the address book: what kinds of records there are and their properties.
#pragma once

#ifdef __cplusplus
extern "C" {
#endif

typedef struct {
  const char* const _uri;
  unsigned int id;
  unsigned int display_name;
  unsigned int display_name_index;
  unsigned int display_contact_id;
  unsigned int ringtone_path;
  unsigned int image_thumbnail_path;
  unsigned int vibration;
  unsigned int status;
  unsigned int is_favorite;
  unsigned int favorite_priority;
  unsigned int link_count;
  unsigned int addressbook_ids;
  unsigned int has_phonenumber;
  unsigned int has_email;
  unsigned int message_alert;
  unsigned int snippet_type;
  unsigned int snippet_string;
} _contacts_person_property_ids;

/// One record per person and number. `number_filter` serves filters only.
typedef struct {
  const char* const _uri;
  unsigned int person_id;
  unsigned int display_name;
  unsigned int display_name_index;
  unsigned int display_contact_id;
  unsigned int ringtone_path;
  unsigned int image_thumbnail_path;
  unsigned int vibration;
  unsigned int is_favorite;
  unsigned int has_phonenumber;
  unsigned int has_email;
  unsigned int number_id;
  unsigned int type;
  unsigned int label;
  unsigned int is_primary_default;
  unsigned int number;
  unsigned int number_filter;
  unsigned int normalized_number;
  unsigned int message_alert;
  unsigned int cleaned_number;
  unsigned int snippet_type;
  unsigned int snippet_string;
} _contacts_person_number_property_ids;

extern const _contacts_person_property_ids _contacts_person;
extern const _contacts_person_number_property_ids _contacts_person_number;

#ifdef __cplusplus
}
#endif
