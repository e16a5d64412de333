#include "host/console/PipedInput.h"

namespace tessel
{
PipedInput::int_type PipedInput::underflow()
{
    std::size_t count = 0;
    while (mSource.read(mBytes.data(), mBytes.size(), count) == InputSource::Outcome::kInterrupted)
        mSource.forgetInterrupts();
    setg(mBytes.data(), mBytes.data(), mBytes.data() + count);
    return count > 0 ? traits_type::to_int_type(mBytes.front()) : traits_type::eof();
}
} // namespace tessel
