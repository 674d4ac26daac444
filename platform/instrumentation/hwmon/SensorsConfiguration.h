// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace Vorn::Hwmon {

// Returns the files that libsensors reads by default, in its order; see sensors.conf(5).
std::vector<std::filesystem::path> configurationFiles();

// The text of all of these files. By default, the parser of libsensors 3.6.0 keeps a pointer to the
// last `chip` statement through sensors_cleanup(); a statement that comes before the first valid
// `chip` statement is then written to freed memory. The text prevents that: it begins with a `chip`
// statement that matches no chip.
class SensorsConfiguration {
public:
    // Throws std::runtime_error naming the file that cannot be read.
    SensorsConfiguration();

    const std::string& text() const { return text_; }

    // Returns the place that a line of the text, counted from 1, comes from, such as
    // "File /etc/sensors3.conf, line 12".
    std::string place(int line) const;

private:
    struct Part {
        std::string file;
        int firstLine; // in the text
    };

    void append(const std::filesystem::path& file);

    std::string text_;
    std::vector<Part> parts_;
};

} // namespace Vorn::Hwmon
