#pragma once

#include "Values/JsonText.h" // IWYU pragma: export
