// The parts of the running host, as the SDK's free functions find them. The parts themselves are given what
// they need when they are made; only a function that an application calls from outside has nothing else to go
// by. Nor has the handler of a signal by which an application ends the process.
//
//     Owned<Document> document;                        // a part, made and published
//     if (auto* current = running<Document>()) ...     // in a free function; null outside of a session
//
// Everything here is for the thread that makes the host; a handler only asks, for a part that has been made
// by then.
#pragma once

#include <utility>

namespace tessel
{
// Makes somebody else's part the running one for as long as this object lives. What was running before runs
// again afterwards, so that a test can put a part of its own in place of a host's.
template <class Part>
class Published
{
public:
    explicit Published(Part& part) : mPart(part), mBefore(std::exchange(theRunning, &part)) {}
    ~Published() { theRunning = mBefore; }
    Published(const Published&) = delete;
    Published& operator=(const Published&) = delete;

    Part& operator*() const { return mPart; }
    Part* operator->() const { return &mPart; }

    static Part* running() { return theRunning; }

private:
    static inline Part* theRunning = nullptr;

    Part& mPart;
    Part* mBefore;
};

// A part together with its publication: it is withdrawn before it goes.
template <class Part>
class Owned
{
public:
    template <class... Arguments>
    explicit Owned(Arguments&&... arguments) : mPart(std::forward<Arguments>(arguments)...)
    {
    }
    Owned(const Owned&) = delete;
    Owned& operator=(const Owned&) = delete;

    Part& operator*() { return mPart; }
    const Part& operator*() const { return mPart; }
    Part* operator->() { return &mPart; }
    const Part* operator->() const { return &mPart; }

private:
    Part mPart;
    Published<Part> mPublished{mPart};
};

// Null while there is none.
template <class Part>
Part* running()
{
    return Published<Part>::running();
}
} // namespace tessel
