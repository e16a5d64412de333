// Windows that wait for a person: while they do, the host stores what the last action wrote, so that an open
// window keeps no other session from the registry.
#pragma once

namespace tessel
{
// Called once, when the application object is there.
void storeBeforeEachWait();

// Around a question that is part of an action, which goes on with the answer: a message box.
class Question
{
public:
    Question();
    ~Question();
    Question(const Question&) = delete;
    Question& operator=(const Question&) = delete;
};
} // namespace tessel
