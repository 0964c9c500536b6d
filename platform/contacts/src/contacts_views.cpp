#include <contacts_views.h>

namespace {

constexpr unsigned int kPerson = 0x100, kNumber = 0x200;

}  // namespace

const _contacts_person_property_ids _contacts_person = {
    "tizen.contacts_view.person",
    kPerson + 1,
    kPerson + 2,
    kPerson + 3,
    kPerson + 4,
    kPerson + 5,
    kPerson + 6,
    kPerson + 7,
    kPerson + 8,
    kPerson + 9,
    kPerson + 10,
    kPerson + 11,
    kPerson + 12,
    kPerson + 13,
    kPerson + 14,
    kPerson + 15,
    kPerson + 16,
    kPerson + 17,
};

const _contacts_person_number_property_ids _contacts_person_number = {
    "tizen.contacts_view.person/simple_contact/number",
    kNumber + 1,
    kNumber + 2,
    kNumber + 3,
    kNumber + 4,
    kNumber + 5,
    kNumber + 6,
    kNumber + 7,
    kNumber + 8,
    kNumber + 9,
    kNumber + 10,
    kNumber + 11,
    kNumber + 12,
    kNumber + 13,
    kNumber + 14,
    kNumber + 15,
    kNumber + 16,
    kNumber + 17,
    kNumber + 18,
    kNumber + 19,
    kNumber + 20,
    kNumber + 21,
};
