#pragma once

#include <exception>

namespace spectrel {

/// Raised when an element of a record's repeated group is read whose index is not below the group's own count.
///
/// Nothing catches it: the process ends. Sections loop only up to the count they read, so it guards the readers.
class ArrayOutOfBoundsException : public std::exception { };

} // namespace spectrel
