#pragma once

#include "tests/realtime/Subject.h"

#include <gtest/gtest.h>

#include <iosfwd>
#include <memory>

namespace realtimeproof
{

// One filter under test; null from `make` if it can't be made.
struct Row
{
    const char* name;
    std::unique_ptr<Subject> (*make)();
};

void PrintTo(const Row& row, std::ostream* out);

// Each technology instantiates it with its rows.
class RealtimeProof : public testing::TestWithParam<Row>
{
};

} // namespace realtimeproof
