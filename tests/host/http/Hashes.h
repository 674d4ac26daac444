// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Hashes of the password "secret" under each scheme; all but one have the least cost.

#pragma once

#include <string>

namespace HttpTests {

inline const std::string yescrypt =
    "$y$j75$rXFh3jJw1MMfCN0LMfxTN/$/4dQYJpjC7h6fw/f28qONzbXJtVT0m.gAeXigje2bt4";
inline const std::string bcrypt = "$2b$04$abcdefghijklmnopqrstuu2r9OfJnfCsdneAXAGHnS4UpFFP8WIrW";
inline const std::string dearBcrypt =
    "$2b$10$abcdefghijklmnopqrstuuqflPDzB6gcMhKa1rZqKiun2YGL5sa2u";
inline const std::string sha512 =
    "$6$saltstring$AIsRs/Ee56G/"
    "tC8MEHhvReZTfx8u3rXXMl6eYrjCG9ibix19DxoMBLogdTET5Ukw9Sf7eZTITsuk0Ry5qulYz.";

} // namespace HttpTests
