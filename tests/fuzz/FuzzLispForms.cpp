// Lisp forms as they are typed, read by the host's Lisp with any text: each text is read to its end or
// answered with one line, and Lisp goes on. Nothing of it is evaluated: that could do whatever a person can.
#include <algorithm>
#include <memory>

#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispInterpreter.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"
#include "tests/fuzz/FuzzHost.h"

namespace
{
constexpr wchar_t kReader[] =
    LR"((defun read-all (text &aux (*read-eval* nil) (*package* (make-package (gensym "FUZZ") :use '(:cl))))
      (unwind-protect (with-input-from-string (stream text)
                        (loop for form = (read stream nil stream) until (eq form stream) collect (type-of form)))
        (delete-package *package*))))";

struct Session
{
    tessel::CommandLine commandLine{[](std::string_view) {
    }};
    tessel::Document document;
    tessel::EndRequest endRequest;
    tessel::LispInterpreter lisp{{}, commandLine, document, endRequest};

    Session() { require(static_cast<bool>(lisp.evaluate(kReader))); }
};

std::wstring quoted(const std::wstring& text)
{
    std::wstring result = L"\"";
    for (const wchar_t character : text)
        if (character == L'"' || character == L'\\')
            result += {L'\\', character};
        else
            result += character;
    return result + L"\"";
}

// Of what is said the words, without names and numbers.
std::wstring kindOf(const std::wstring& sentence)
{
    return sentence.substr(0, sentence.find_first_of(L"0123456789\"#"));
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static Session session;
    const std::wstring text = tessel::toWide(std::string(data, data + size));
    const auto read = session.lisp.evaluate(L"(read-all " + quoted(text) + L")");
    note(kindOf(read ? *read : read.sentence()));
    if (!read)
        require(!read.sentence().empty() && read.sentence().find(L'\n') == std::wstring::npos);
    const auto sum = session.lisp.evaluate(L"(+ 40 2)");
    require(sum && *sum == L"42");
    return 0;
}
