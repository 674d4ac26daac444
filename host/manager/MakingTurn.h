// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What is to be made once, though several threads ask for it and no lock is held meanwhile.

#pragma once

#include <string>

namespace Host {

// The turn to make a thing: one thread of the process has it, others wait until it goes. Whoever
// gets it sees first whether the thing was made before.
//
// A thread that makes one thing may ask for another: providers' factories call up.
class MakingTurn {
public:
    // The thing is known by a text. Throws std::runtime_error where the wait would never end: this
    // thread is making the thing already, or those that make it wait for what this thread makes.
    explicit MakingTurn(const std::string& thing);
    ~MakingTurn();
    MakingTurn(const MakingTurn&) = delete;
    MakingTurn& operator=(const MakingTurn&) = delete;

private:
    const std::string thing_;
};

} // namespace Host
