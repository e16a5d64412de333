// What is said when the start is over, in place of a box for each thing that went wrong on the way.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "host/applications/LoadOutcomes.h"
#include "host/messages/MessageBox.h"

namespace tessel
{
struct StartSummary
{
    MessageBox::Box box;
    std::wstring lines; // the same for the command line, whole
    bool fits = true;   // the box holds all of it, too
};

// A box has no place for the file that it is about but its text: there the file stands between “ and ”, in
// every language. Of a translation with quotes of another kind no file is noted here; boxes about one that
// was not loaded are recognised all the same.
//
// Whoever loads files says first what is wrong with one, and then that it was not loaded. Files that two
// boxes quote, and of which neither the linker nor Lisp has heard, are noted as not loaded for the reason in
// the first.
void noteRefusedFiles(const std::vector<MessageBox::Box>& boxes, LoadOutcomes& outcomes);

// Of what was not loaded, and of the boxes that came up meanwhile. Those that name a file that was not loaded
// say nothing new. What is kept out has not failed. Nothing to say: none.
std::optional<StartSummary> summarize(const std::vector<LoadOutcome>& failed,
                                      const std::vector<MessageBox::Box>& boxes);
} // namespace tessel
