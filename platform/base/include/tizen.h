#pragma once

#include <tizen_error.h>
#include <tizen_type.h>
