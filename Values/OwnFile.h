#pragma once

#include "Values/Result.h"

#include <cstdint>
#include <string>

namespace spectrel {

// Output files that nobody else can plant, read or swap.

/// What becomes of a file that is there already.
enum class IfThere : std::uint8_t { Refuse, Overwrite };

/// Opens a file for writing, from its start on, nothing taken away; the caller closes the descriptor.
///
/// A new file has mode 0600, and no link is followed to its place. One that is there fails with `Exists`, or is opened
/// when it may be overwritten and is this user's alone: a regular file of this user without a further name (it gets
/// mode 0600), a FIFO of this user, which is waited for until somebody reads it, or a device. Anything else fails with
/// `Refused`. Links are followed below /dev and /proc alone ("/dev/stdout"), where nobody can plant one.
Result<int> openOwnFile(const std::string& path, IfThere ifThere);

/// Makes the folders of a path that are missing, mode 0700. Fails, naming the folder, where one cannot be made, and
/// where one that stands in a folder that everybody can write (such as the temporary one) is a link or belongs to
/// neither this user nor the system's administrator.
Outcome makeOwnFolders(const std::string& path);

} // namespace spectrel
