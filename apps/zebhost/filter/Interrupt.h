#pragma once

namespace zebhost::interrupt
{

enum class Second
{
    EndsAtOnce,
    Ignored // for work that answers to the first within a moment, and has something to put in order by then
};

// From now on the first Ctrl-C, Ctrl-\, hang-up or termination request is only noted, so that work can end cleanly
// between two steps. A signal that was ignored stays so.
void Watch(Second second = Second::EndsAtOnce);

bool IsRequested();

} // namespace zebhost::interrupt
