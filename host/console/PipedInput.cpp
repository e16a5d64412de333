#include "host/console/PipedInput.h"

namespace tessel
{
PipedInput::int_type PipedInput::underflow()
{
    InputSource::Outcome outcome = mSource.wait();
    for (; outcome == InputSource::Outcome::kInterrupted; outcome = mSource.wait())
        mSource.forgetInterrupts();
    const std::size_t count =
        outcome == InputSource::Outcome::kReady ? mSource.read(mBytes.data(), mBytes.size()) : 0;
    setg(mBytes.data(), mBytes.data(), mBytes.data() + count);
    return count > 0 ? traits_type::to_int_type(mBytes.front()) : traits_type::eof();
}
} // namespace tessel
