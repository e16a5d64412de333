// Asking the person for something. While a window of the host's is open (Modrig's dialog loads the file that
// asks) the question comes in a window over it, with the application's name as its title. Otherwise, at a
// terminal, it stands on the command line and waits; in a script or a pipe the next line is the answer, and
// it is shown like a line that was typed. Where there is none of these (while the host starts, in a command
// of `-c`, among the files that come with `--modrig`) the default is taken at once, and a question without
// one counts as cancelled.
//
// Ctrl-C, the end of the input, the end of the session and closing its window cancel a question. An empty
// line takes the default; in a window that stands in the field, to be changed or taken. An answer that does
// not fit is explained in a sentence, and the person is asked again; a script is not: its question is
// cancelled then.
//
// All of these answer one of the codes below. `question` is one line, without a colon at its end. What is
// stored before the wait is told by `tsrxBeforeWaiting(false)`, which these call. For the thread of the host.
#pragma once

#include "tsdefs.h"

inline constexpr int TSASK_ANSWERED = 0;
inline constexpr int TSASK_CANCELLED = 1; // what was to receive the answer is not touched
// No question, nothing to receive the answer, or a default that has no room in there; nobody was asked.
inline constexpr int TSASK_INVALID = 2;

// A text, as it was typed. `byDefault` may be null: then an empty line is an empty text. `answer` has room
// for `capacity` characters, the terminator included; longer answers do not fit.
TESSEL_API int tsaskText(const wchar_t* question, const wchar_t* byDefault, wchar_t* answer,
                         std::size_t capacity);

// A number, with a point before its fraction and perhaps an exponent: 12, -0.5, 1e3. `byDefault` may be null.
TESSEL_API int tsaskNumber(const wchar_t* question, const double* byDefault, double* answer);

// Yes or no, of which the beginning is enough, in any case. `byDefault` may be null.
TESSEL_API int tsaskYesOrNo(const wchar_t* question, const bool* byDefault, bool* answer);

// A file: its full path, from the current folder where it was typed without one, from the person's own after
// "~/"; quotes around it are left out. `mustExist`: the name of something else than an ordinary file that is
// there does not fit. `byDefault` may be null; `path` and `capacity` are as for a text: the full path of the
// default, too, is to have room.
TESSEL_API int tsaskFile(const wchar_t* question, const wchar_t* byDefault, bool mustExist, wchar_t* path,
                         std::size_t capacity);
