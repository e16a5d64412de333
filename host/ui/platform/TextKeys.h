// The keys of text fields.
#pragma once

namespace tessel::windowing
{
// From now on the platform's keys for selecting all, copying, pasting, cutting and undoing work in every
// field where a text is typed or can be selected.
void takeTextKeys();
} // namespace tessel::windowing
