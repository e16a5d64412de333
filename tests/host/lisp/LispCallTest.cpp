#include <cmath>
#include <memory>

#include <gmock/gmock.h>

#include "tests/host/lisp/LispSession.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;

namespace
{
std::string described(const TsResultBuffer& buffer)
{
    switch (buffer.type)
    {
    case TS_SHORT:
        return "short " + std::to_string(buffer.value.shortNumber);
    case TS_LONG:
        return "long " + std::to_string(buffer.value.longNumber);
    case TS_REAL:
        return "real " + std::to_string(buffer.value.real);
    case TS_STRING:
        return "string " + tessel::toUtf8(buffer.value.string);
    case TS_TRUE:
        return "true";
    case TS_NIL:
        return "nil";
    default:
        return "type " + std::to_string(buffer.type);
    }
}

struct Called
{
    int status = 0;
    std::vector<std::string> values;
};

Called call(std::initializer_list<TsRbValue> values)
{
    const std::unique_ptr<TsResultBuffer, int (*)(TsResultBuffer*)> list(tsutBuildList(values), tsutRelRb);
    TsResultBuffer* result = nullptr;
    Called called{tsedInvoke(list.get(), &result), {}};
    for (const auto* value = result; value; value = value->next)
        called.values.push_back(described(*value));
    tsutRelRb(result);
    return called;
}
} // namespace

TEST(LispCall, HandsOverValuesOfEveryKind)
{
    LispSession session;
    session.value("(defun see (&rest values) (format t \"~s~%\" values) nil)");
    const auto called =
        call({TsRbValue::String(L"see"), TsRbValue::String(L"größe 🙂"), TsRbValue::Short(-5),
              TsRbValue::Long(100000), TsRbValue::Real(2.5), TsRbValue::TrueValue(), TsRbValue::NilValue()});
    EXPECT_EQ(called.status, TS_NORMAL);
    EXPECT_THAT(called.values, ElementsAre());
    EXPECT_EQ(session.output(), "(\"größe 🙂\" -5 100000 2.5d0 T NIL)\n");
}

TEST(LispCall, BringsValuesOfEveryKindBack)
{
    LispSession session;
    session.value(
        "(defun all () (list \"größe\" 32767 -32768 32768 -2147483648 2147483648 1/4 2.5 t nil 'name #\\a))");
    EXPECT_THAT(call({TsRbValue::String(L"all")}).values,
                ElementsAre("string größe", "short 32767", "short -32768", "long 32768", "long -2147483648",
                            "real 2147483648.000000", "real 0.250000", "real 2.500000", "true", "nil",
                            "string NAME", "string a"));
}

TEST(LispCall, BringsAnAtomBackAsAListOfOne)
{
    LispSession session;
    session.value("(defun same (x) x)");
    EXPECT_THAT(call({TsRbValue::String(L"SAME"), TsRbValue::Short(7)}).values, ElementsAre("short 7"));
    EXPECT_THAT(call({TsRbValue::String(L"same"), TsRbValue::TrueValue()}).values, ElementsAre("true"));
    EXPECT_THAT(call({TsRbValue::String(L"same"), TsRbValue::NilValue()}).values, ElementsAre());
}

TEST(LispCall, FlattensListsWithinTheList)
{
    LispSession session;
    session.value("(defun nested () '(1 (2 (3) nil) ((4)) (5 . 6)))");
    EXPECT_THAT(call({TsRbValue::String(L"nested")}).values,
                ElementsAre("short 1", "short 2", "short 3", "nil", "short 4", "short 5", "short 6"));
}

TEST(LispCall, BringsOtherObjectsBackAsTheyPrint)
{
    LispSession session;
    session.value("(defun other () (list #(1 2) #c(1 2)))");
    EXPECT_THAT(call({TsRbValue::String(L"other")}).values, ElementsAre("string #(1 2)", "string #C(1 2)"));
}

TEST(LispCall, RefusesACircularAnswer)
{
    LispSession session;
    session.value("(defun ring () (let ((l (list 1))) (setf (cdr l) l)))");
    EXPECT_EQ(call({TsRbValue::String(L"ring")}).status, TS_ERROR);
    EXPECT_EQ(session.output(), "The answer holds more than 100000 values, or is circular.\n");
}

TEST(LispCall, SaysAnErrorInOneLine)
{
    LispSession session;
    session.value("(defun fails (x) (error \"no ~a\" x))");
    EXPECT_EQ(call({TsRbValue::String(L"fails"), TsRbValue::String(L"luck")}).status, TS_ERROR);
    EXPECT_EQ(call({TsRbValue::String(L"unknown")}).status, TS_ERROR);
    EXPECT_EQ(call({TsRbValue::String(L"if")}).status, TS_ERROR);
    EXPECT_EQ(session.output(),
              "no luck\nThere is no Lisp function unknown.\nThere is no Lisp function if.\n");
}

TEST(LispCall, RefusesAListWithoutAName)
{
    LispSession session;
    TsResultBuffer* result = nullptr;
    EXPECT_EQ(tsedInvoke(nullptr, &result), TS_ERROR);
    EXPECT_EQ(call({TsRbValue::Short(1)}).status, TS_ERROR);
    EXPECT_EQ(result, nullptr);
}

TEST(LispCall, RunsAtOnceAheadOfTheQueue)
{
    LispSession session;
    qxr_queueexpr(L"(write-line \"queued\")");
    call({TsRbValue::String(L"write-line"), TsRbValue::String(L"called")});
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "called\nqueued\n");
}

TEST(LispCall, LoadsAFileWhosePathHasBackslashes)
{
    LispSession session;
    const TemporaryFolder folder;
    folder.write("sub/app.lsp", "(write-line \"loaded\")");
    auto path = (folder / "sub").wstring() + L"\\app.lsp";
    const auto called = call({TsRbValue::String(L"qz-load"), TsRbValue::String(path.c_str()),
                              TsRbValue::Short(0), TsRbValue::Short(0)});
    EXPECT_EQ(called.status, TS_NORMAL) << session.output();
    EXPECT_EQ(session.output(), "loaded\n");
    EXPECT_THAT(session.documentNames(), ElementsAre(tessel::toUtf8(path)));
}

TEST(LispCall, TakesAFileWithABackslashInItsNameFirst)
{
    LispSession session;
    const TemporaryFolder folder;
    folder.write("a/b.lsp", "(write-line \"in a folder\")");
    folder.write("a\\b.lsp", "(write-line \"a name\")");
    const auto path = (folder / "a\\b.lsp").wstring();
    call({TsRbValue::String(L"qz-load"), TsRbValue::String(path.c_str()), TsRbValue::Short(0),
          TsRbValue::Short(0)});
    EXPECT_EQ(session.output(), "a name\n");
}

TEST(LispCall, SaysThatAFileToLoadIsMissing)
{
    LispSession session;
    const auto called = call({TsRbValue::String(L"qz-load"), TsRbValue::String(L"C:\\no\\such.lsp"),
                              TsRbValue::Short(0), TsRbValue::Short(0)});
    EXPECT_EQ(called.status, TS_ERROR);
    EXPECT_EQ(session.output(), "Cannot load \"C:\\no\\such.lsp\": No such file or directory.\n");
}
