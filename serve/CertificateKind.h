#pragma once

namespace ktr::serve {

/// What the development service shows its clients to prove that it is "localhost".
enum class CertificateKind {
    Good,
    Expired,    ///< a day ago
    WrongHost,  ///< made out to another name
    Foreign,    ///< by an authority that nobody trusts
};

}  // namespace ktr::serve
