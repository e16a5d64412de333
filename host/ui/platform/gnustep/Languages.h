#pragma once

namespace tessel::windowing
{
// From now on the texts of bundles come in the languages that the host's own come in. The toolkit by itself
// knows only those that the system has data of.
void takePersonsLanguages();
} // namespace tessel::windowing
