#pragma once

#include <stdbool.h>
