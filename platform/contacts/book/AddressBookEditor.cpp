#include <contacts/AddressBookEditor.h>

#include <base/Deadline.h>

#include "BookConnection.h"
#include "PersonReader.h"

namespace contacts {

using common::Out;
using common::Owned;
using common::OwnedError;
using common::OwnedText;

struct AddressBookEditor::Private {
  OwnedBook book = openAddressBook();
};

namespace {

void setNumbers(EContact* contact, const std::vector<std::string>& numbers) {
  for (const auto& number : numbers) {
    EVCardAttribute* attribute = e_vcard_attribute_new(nullptr, EVC_TEL);
    e_vcard_attribute_add_param_with_value(attribute, e_vcard_attribute_param_new(EVC_TYPE),
                                           "CELL");
    e_vcard_add_attribute_with_value(E_VCARD(contact), attribute, number.c_str());
  }
}

bool setPicture(EContact* contact, const std::string& path, std::string& error) {
  if (path.empty()) return true;
  char* data = nullptr;
  gsize size = 0;
  OwnedError failure;
  if (!g_file_get_contents(path.c_str(), &data, &size, Out(failure))) {
    error = failure->message;
    return false;
  }
  const OwnedText contents(data);
  const Owned<EContactPhoto, e_contact_photo_free> photo(e_contact_photo_new());
  photo->type = E_CONTACT_PHOTO_TYPE_INLINED;
  e_contact_photo_set_inlined(photo.get(), reinterpret_cast<const guchar*>(data), size);
  const OwnedText guess(
      g_content_type_guess(path.c_str(), reinterpret_cast<const guchar*>(data), size, nullptr));
  const OwnedText mime(g_content_type_get_mime_type(guess.get()));
  if (mime) e_contact_photo_set_mime_type(photo.get(), mime.get());
  e_contact_set(contact, E_CONTACT_PHOTO, photo.get());
  return true;
}

bool fail(const OwnedError& failure, std::string& error) {
  if (!failure) return false;
  error = failure->message;
  return true;
}

bool store(EBookClient* book, GSList* contacts, std::string& error) {
  const base::Deadline deadline(kPatience);
  OwnedError failure;
  e_book_client_add_contacts_sync(book, contacts, E_BOOK_OPERATION_FLAG_NONE, nullptr,
                                  deadline.cancellable(), Out(failure));
  return !fail(failure, error);
}

/// The contacts of exactly that name.
OwnedContacts named(EBookClient* book, const std::string& name, std::string& error) {
  const base::Deadline deadline(kPatience);
  OwnedError failure;
  OwnedContacts found;
  const OwnedContacts contacts = allContacts(book, deadline.cancellable(), Out(failure));
  if (fail(failure, error)) return nullptr;
  for (const GSList* item = contacts.get(); item; item = item->next) {
    auto* contact = static_cast<EContact*>(item->data);
    if (readPerson(contact).name != name) continue;
    found.reset(g_slist_prepend(found.release(), g_object_ref(contact)));
  }
  if (!found) error = "there is no contact '" + name + "'";
  return found;
}

}  // namespace

AddressBookEditor::AddressBookEditor() : _d(std::make_unique<Private>()) {}
AddressBookEditor::~AddressBookEditor() = default;

bool AddressBookEditor::isOpen() const {
  return _d->book != nullptr;
}

bool AddressBookEditor::add(const Entry& entry, std::string& error) {
  return add(std::vector<Entry>{entry}, error);
}

bool AddressBookEditor::add(const std::vector<Entry>& entries, std::string& error) {
  OwnedContacts contacts;
  for (const auto& entry : entries) {
    OwnedContact contact(e_contact_new());
    e_contact_set(contact.get(), E_CONTACT_FULL_NAME, entry.name.c_str());
    setNumbers(contact.get(), entry.numbers);
    if (!setPicture(contact.get(), entry.picture, error)) return false;
    contacts.reset(g_slist_prepend(contacts.release(), contact.release()));
  }
  return store(_d->book.get(), contacts.get(), error);
}

bool AddressBookEditor::import(const std::string& vcards, std::string& error) {
  static const std::string kBegin = "BEGIN:VCARD";
  OwnedContacts contacts;
  size_t begin = vcards.find(kBegin);
  while (begin != std::string::npos) {
    const size_t next = vcards.find(kBegin, begin + kBegin.size());
    EContact* contact = e_contact_new_from_vcard(vcards.substr(begin, next - begin).c_str());
    if (contact) contacts.reset(g_slist_prepend(contacts.release(), contact));
    begin = next;
  }
  if (!contacts) {
    error = "there is no contact in the file";
    return false;
  }
  return store(_d->book.get(), contacts.get(), error);
}

bool AddressBookEditor::rename(const std::string& from, const std::string& to, std::string& error) {
  const OwnedContacts contacts = named(_d->book.get(), from, error);
  if (!contacts) return false;
  for (const GSList* item = contacts.get(); item; item = item->next) {
    auto* contact = static_cast<EContact*>(item->data);
    // The parts of the name would otherwise bring the old one back.
    e_vcard_remove_attributes(E_VCARD(contact), nullptr, EVC_N);
    e_contact_set(contact, E_CONTACT_FULL_NAME, to.c_str());
  }
  const base::Deadline deadline(kPatience);
  OwnedError failure;
  e_book_client_modify_contacts_sync(_d->book.get(), contacts.get(), E_BOOK_OPERATION_FLAG_NONE,
                                     deadline.cancellable(), Out(failure));
  return !fail(failure, error);
}

bool AddressBookEditor::remove(const std::string& name, std::string& error) {
  const OwnedContacts contacts = named(_d->book.get(), name, error);
  if (!contacts) return false;
  Owned<GSList, g_slist_free> uids;
  for (const GSList* item = contacts.get(); item; item = item->next) {
    gpointer uid = const_cast<gpointer>(
        e_contact_get_const(static_cast<EContact*>(item->data), E_CONTACT_UID));
    uids.reset(g_slist_prepend(uids.release(), uid));
  }
  const base::Deadline deadline(kPatience);
  OwnedError failure;
  e_book_client_remove_contacts_sync(_d->book.get(), uids.get(), E_BOOK_OPERATION_FLAG_NONE,
                                     deadline.cancellable(), Out(failure));
  return !fail(failure, error);
}

std::vector<AddressBookEditor::Entry> AddressBookEditor::all() {
  const base::Deadline deadline(kPatience);
  const OwnedContacts contacts = allContacts(_d->book.get(), deadline.cancellable(), nullptr);
  std::vector<Entry> entries;
  for (const GSList* item = contacts.get(); item; item = item->next) {
    const Person person = readPerson(static_cast<EContact*>(item->data));
    entries.push_back({person.name, person.numbers, person.picture});
  }
  return entries;
}

}  // namespace contacts
