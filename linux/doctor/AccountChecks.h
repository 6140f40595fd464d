#pragma once

#include "linux/configuration/Configuration.h"
#include "linux/doctor/CheckUp.h"

namespace ktr::linux_ {

/// What a check-up finds about account, secret and service. Each may wait; any thread.
namespace account_checks {

CheckUp::Finding configuration(const CheckUp::Places& places);
CheckUp::Finding account(const Configuration& configuration);
CheckUp::Finding secret(const CheckUp::Places& places, const Configuration& configuration);
/// The host's name, or its address.
CheckUp::Finding name(const Configuration& configuration);
/// Connection, certificate, credentials and answer.
CheckUp::Finding service(const CheckUp::Places& places, const Configuration& configuration);
CheckUp::Finding clock(const CheckUp::Places& places, const Configuration& configuration);
/// The host that the service redirected to last.
CheckUp::Finding redirect(const CheckUp::Places& places, const Configuration& configuration);

}  // namespace account_checks

}  // namespace ktr::linux_
