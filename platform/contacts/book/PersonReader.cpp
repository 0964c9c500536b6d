#include "PersonReader.h"

#include <common/Owned.h>
#include <dlog.h>

namespace contacts {
namespace {

using common::Out;
using common::Owned;
using common::OwnedError;
using common::OwnedText;

void freeAttributes(GList* attributes) {
  g_list_free_full(attributes, reinterpret_cast<GDestroyNotify>(e_vcard_attribute_free));
}

std::string text(const char* maybe) {
  return maybe ? maybe : "";
}

/// Address books that keep pictures inside the record have them written to the cache, once.
std::string cachedPicture(const guchar* data, gsize size) {
  const OwnedText name(g_compute_checksum_for_data(G_CHECKSUM_SHA256, data, size));
  const OwnedText folder(g_build_filename(g_get_user_cache_dir(), "contact-pictures", nullptr));
  const OwnedText path(g_build_filename(folder.get(), name.get(), nullptr));
  if (g_file_test(path.get(), G_FILE_TEST_EXISTS)) return path.get();
  OwnedError error;
  g_mkdir_with_parents(folder.get(), 0700);
  if (!g_file_set_contents(path.get(), reinterpret_cast<const char*>(data),
                           static_cast<gssize>(size), Out(error))) {
    dlog_print(DLOG_ERROR, "CONTACTS", "a picture is lost: %s", error->message);
    return {};
  }
  return path.get();
}

std::string pictureOf(EContact* contact) {
  const Owned<EContactPhoto, e_contact_photo_free> photo(
      static_cast<EContactPhoto*>(e_contact_get(contact, E_CONTACT_PHOTO)));
  if (!photo) return {};
  if (photo->type == E_CONTACT_PHOTO_TYPE_URI) {
    const OwnedText path(g_filename_from_uri(photo->data.uri, nullptr, nullptr));
    return text(path.get());
  }
  gsize size = 0;
  const guchar* data = e_contact_photo_get_inlined(photo.get(), &size);
  return data && size ? cachedPicture(data, size) : std::string();
}

std::vector<std::string> numbersOf(EContact* contact) {
  const Owned<GList, freeAttributes> attributes(e_contact_get_attributes(contact, E_CONTACT_TEL));
  std::vector<std::string> numbers;
  for (const GList* item = attributes.get(); item; item = item->next) {
    const OwnedText number(e_vcard_attribute_get_value(static_cast<EVCardAttribute*>(item->data)));
    if (number && *number) numbers.emplace_back(number.get());
  }
  return numbers;
}

}  // namespace

Person readPerson(EContact* contact) {
  Person person;
  person.name = text(static_cast<const char*>(e_contact_get_const(contact, E_CONTACT_FULL_NAME)));
  person.picture = pictureOf(contact);
  person.numbers = numbersOf(contact);
  person.hasMail = e_contact_get_const(contact, E_CONTACT_EMAIL_1) != nullptr;
  return person;
}

}  // namespace contacts
