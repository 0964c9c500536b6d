/// Launch requests as bundles.
#pragma once

#include <app_control.h>
#include <bundle.h>

#ifdef __cplusplus
extern "C" {
#endif

/// Replaces everything in the request by a copy of the bundle.
int app_control_import_from_bundle(app_control_h app_control, bundle* data);
/// A new bundle, to be freed with bundle_free().
int app_control_export_as_bundle(app_control_h app_control, bundle** data);
/// A request with a copy of the bundle.
int app_control_create_request(bundle* data, app_control_h* app_control);
/// A received request with a copy of the bundle, its caller included.
int app_control_create_event(bundle* data, app_control_h* app_control);

#ifdef __cplusplus
}
#endif
