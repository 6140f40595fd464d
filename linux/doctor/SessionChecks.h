#pragma once

#include "linux/configuration/Configuration.h"
#include "linux/doctor/CheckUp.h"

namespace ktr::linux_ {

/// What a check-up finds about this computer and its session. Each may wait; any thread, but for `letters`.
namespace session_checks {

CheckUp::Finding contacts(const Configuration& configuration);
/// The desktop's, beside the files.
CheckUp::Finding addressBooks(const CheckUp::Places& places, const Configuration& configuration);
CheckUp::Finding positions(const CheckUp::Places& places, const Configuration& configuration);
CheckUp::Finding maps(const CheckUp::Places& places, const Configuration& configuration);
/// By script, of the fonts that are installed. Main thread.
CheckUp::Finding letters();
CheckUp::Finding locale(const CheckUp::Places& places);
/// The bus of screen readers, with a connection of its own.
CheckUp::Finding screenReader(const CheckUp::Places& places);
/// What the desktop offers to programs: its settings, and opening links.
CheckUp::Finding portals(const CheckUp::Places& places);

}  // namespace session_checks

}  // namespace ktr::linux_
