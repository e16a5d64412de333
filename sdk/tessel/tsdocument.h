// The current document and the applications loaded into it.
#pragma once

#include "tsdefs.h"

class TESSEL_API TsApDocument
{
public:
    TsApDocument() = default;
    TsApDocument(const TsApDocument&) = delete;
    TsApDocument& operator=(const TsApDocument&) = delete;
    virtual ~TsApDocument() = default;

    // Lisp files that were loaded into the document without an error, each once, in order of first load.
    virtual int loadedApplicationCount() const = 0;

    // The full path of the application at an index from 0; null outside the range. Valid until the next
    // application is loaded.
    virtual const wchar_t* loadedApplicationName(int index) const = 0;
};

// Null while the host has no document.
TESSEL_API TsApDocument* curDoc();
