// Veltrix — KPI dashboard for small businesses.
#pragma once

// Whether a produce or a load is under way. A network source waits for its answers in an event
// loop, where timers still fire; what they would tear down (the source, the database, the
// program) has to wait until the work is done.
class BusyState
{
public:
    // Held for the length of one piece of work; pieces may nest.
    class Scope
    {
    public:
        explicit Scope(BusyState &state)
            : m_state(state)
        {
            ++m_state.m_depth;
        }
        ~Scope() { --m_state.m_depth; }
        Scope(const Scope &) = delete;
        Scope &operator=(const Scope &) = delete;

    private:
        BusyState &m_state;
    };

    bool isBusy() const { return m_depth > 0; }

private:
    int m_depth = 0;
};
