#include <base/Fault.h>
#include <contacts.h>

#include "Filter.h"

int contacts_query_create(const char* view_uri, contacts_query_h* query) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_OUT_OF_MEMORY;
  const auto view = contacts::viewOf(view_uri);
  if (!query || !view) return CONTACTS_ERROR_INVALID_PARAMETER;
  *query = new contacts_query_s{*view, std::nullopt, {}, std::nullopt};
  return CONTACTS_ERROR_NONE;
}

int contacts_query_destroy(contacts_query_h query) {
  if (!query) return CONTACTS_ERROR_INVALID_PARAMETER;
  delete query;
  return CONTACTS_ERROR_NONE;
}

int contacts_query_set_filter(contacts_query_h query, contacts_filter_h filter) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_OUT_OF_MEMORY;
  if (!query || !filter || filter->view != query->view || filter->expectsCondition) {
    return CONTACTS_ERROR_INVALID_PARAMETER;
  }
  query->filter = *filter;
  return CONTACTS_ERROR_NONE;
}

int contacts_query_set_projection(contacts_query_h query, unsigned int property_id_array[],
                                  int count) {
  if (!query || !property_id_array || count <= 0) return CONTACTS_ERROR_INVALID_PARAMETER;
  query->projection.assign(property_id_array, property_id_array + count);
  return CONTACTS_ERROR_NONE;
}

int contacts_query_set_sort(contacts_query_h query, unsigned int property_id, bool is_ascending) {
  if (!query) return CONTACTS_ERROR_INVALID_PARAMETER;
  query->sort = {property_id, is_ascending};
  return CONTACTS_ERROR_NONE;
}
