#pragma once

#include <app_common.h>
#include <app_control.h>
