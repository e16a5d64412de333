#include "host/ui/QuestionLayout.h"

#include <algorithm>

namespace tessel::asking
{
namespace
{
constexpr double kGap = 12;
constexpr double kFieldGap = 6; // to the text that it belongs to
constexpr double kHighestExplanation = 84;
constexpr double kLowestText = 48;

// Stacks parts from below; what has no height takes no room.
class Stack
{
public:
    explicit Stack(double bottom) : mTop(bottom) {}

    Band add(double height, double gap)
    {
        const Band part{mTop, height};
        if (height > 0)
            mTop += height + gap;
        return part;
    }
    double top() const { return mTop; }

private:
    double mTop;
};
} // namespace

QuestionLayout layoutOf(const Wanted& wanted, double highest)
{
    QuestionLayout layout;
    Stack stack(kMargin);
    layout.buttons = stack.add(kButtonHeight, kMargin);
    layout.explanation = stack.add(std::min(wanted.explanation, kHighestExplanation), kGap);
    layout.field = stack.add(wanted.hasField ? kFieldHeight : 0, kFieldGap);
    const double room = std::max(kLowestText, highest - kMargin - stack.top());
    layout.text = stack.add(std::min(wanted.text, room), kMargin);
    layout.height = stack.top();
    return layout;
}
} // namespace tessel::asking
