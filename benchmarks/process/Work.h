#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace zebaudiofilterhost::benchmarks
{

/// What is measured: one thing, done over and over.
class Work
{
public:
    virtual ~Work() = default;

    /// One block.
    virtual void Run() = 0;

    /// Runs some blocks and throws std::runtime_error if they did not do what they are measured for.
    virtual void Verify() = 0;
};

/// One way of one row. Without `make` it is the control: the same object as the first way of its row.
struct Case
{
    std::string row;
    std::string way;
    std::function<std::unique_ptr<Work>()> make;
};

/// A plug-in of few parameters at each block size; of many parameters; and with changes of parameters.
void AddEffectCases(std::vector<Case>& cases);

/// Channel maps, and channels that pass by the plug-in.
void AddMapCases(std::vector<Case>& cases);

} // namespace zebaudiofilterhost::benchmarks
