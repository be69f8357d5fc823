// The clock that the module's pauses run on, in a test process that links
// fast_clock.cpp: shortened by a divisor, and held while paused.
#ifndef _VSPR_indication_FastClock_h
#define _VSPR_indication_FastClock_h

namespace fast_clock
{

// Every pause that a select() without descriptors makes lasts this many
// times less (1 gives back the real clock).
void setDivisor(unsigned divisor);

// While paused, such a pause doesn't begin, so the delivery thread stands
// still; resume() lets it go on.
void pause();
void resume();

} // namespace fast_clock

#endif
