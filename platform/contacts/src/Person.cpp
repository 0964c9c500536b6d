#include "Person.h"

namespace contacts {
namespace {

GVariant* textOf(const std::string& text) {
  return g_variant_new_take_string(g_utf8_make_valid(text.c_str(), -1));
}

}  // namespace

GVariant* toVariant(const std::vector<Person>& persons) {
  GVariantBuilder list;
  g_variant_builder_init(&list, G_VARIANT_TYPE("a(issasb)"));
  for (const Person& person : persons) {
    GVariantBuilder numbers;
    g_variant_builder_init(&numbers, G_VARIANT_TYPE_STRING_ARRAY);
    for (const auto& number : person.numbers) {
      g_variant_builder_add_value(&numbers, textOf(number));
    }
    g_variant_builder_add(&list, "(i@s@sasb)", person.id, textOf(person.name),
                          textOf(person.picture), &numbers, person.hasMail);
  }
  return g_variant_new("(a(issasb))", &list);
}

std::vector<Person> fromVariant(GVariant* persons) {
  std::vector<Person> result;
  GVariantIter* list = nullptr;
  g_variant_get(persons, kPersonsType, &list);
  const char *name = nullptr, *picture = nullptr, *number = nullptr;
  GVariantIter* numbers = nullptr;
  gint32 id = 0;
  gboolean hasMail = FALSE;
  while (g_variant_iter_loop(list, "(i&s&sasb)", &id, &name, &picture, &numbers, &hasMail)) {
    Person& person = result.emplace_back();
    person.id = id;
    person.name = name;
    person.picture = picture;
    while (g_variant_iter_next(numbers, "&s", &number)) person.numbers.emplace_back(number);
    person.hasMail = hasMail;
  }
  g_variant_iter_free(list);
  return result;
}

std::string digitsOf(const std::string& number) {
  std::string digits;
  for (const char c : number) {
    if (g_ascii_isdigit(c) || (c == '+' && digits.empty())) digits += c;
  }
  return digits == "+" ? std::string() : digits;
}

}  // namespace contacts
