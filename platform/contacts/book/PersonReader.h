#pragma once

#include <libebook/libebook.h>

#include "Person.h"

namespace contacts {

/// Everything but the id.
Person readPerson(EContact* contact);

}  // namespace contacts
