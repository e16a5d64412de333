// How a part of the host answers where it may fail: with a value, or with what went wrong. The part itself
// does not speak: whoever asked decides whether a person is told, and nobody passes over an answer without
// writing so.
#pragma once

#include <optional>
#include <string>
#include <utility>

namespace tessel
{
struct [[nodiscard]] Failure
{
    static constexpr int kUnspecified = 1;

    // What a person reads: a sentence, or the end of one where the function that fails says so. Empty where
    // several things failed and have been told one by one.
    std::wstring sentence;
    // For callers that do different things about different failures.
    int code = kUnspecified;
};

// What every result has, whatever its value.
class [[nodiscard]] Outcome
{
public:
    explicit operator bool() const { return !mFailed; }

    // Both say nothing of a success: an empty text, and 0.
    const std::wstring& sentence() const { return mFailure.sentence; }
    int code() const { return mFailure.code; }

    // What went wrong, to be handed on as a result of another kind. Only of a failed one.
    const Failure& failure() const { return mFailure; }

protected:
    Outcome() = default;
    explicit Outcome(Failure failure) : mFailed(true), mFailure(std::move(failure)) {}
    ~Outcome() = default;
    Outcome(const Outcome&) = default;
    Outcome(Outcome&&) = default;
    Outcome& operator=(const Outcome&) = default;
    Outcome& operator=(Outcome&&) = default;

private:
    bool mFailed = false;
    Failure mFailure{{}, 0};
};

template <class Value = void>
class [[nodiscard]] Result : public Outcome
{
public:
    Result(Value value) : mValue(std::move(value)) {}
    Result(Failure failure) : Outcome(std::move(failure)) {}

    // Only of one that succeeded.
    Value& operator*() & { return *mValue; }
    const Value& operator*() const& { return *mValue; }
    Value&& operator*() && { return *std::move(mValue); }
    Value* operator->() { return &*mValue; }
    const Value* operator->() const { return &*mValue; }

private:
    std::optional<Value> mValue;
};

template <>
class [[nodiscard]] Result<void> : public Outcome
{
public:
    Result() = default;
    Result(Failure failure) : Outcome(std::move(failure)) {}
};
} // namespace tessel
