#pragma once

#include "framework/messages/messages.h"

#include <initializer_list>
#include <string>
#include <string_view>

namespace Stillmark
{

/// What the controls say, a line each, for scripts. Flushed at every line.
///
///     value ID PHASE VALUE     PHASE: set click dragBegin drag dragEnd editBegin edit editEnd; texts are quoted
///     command ID
///     scroll ID X,Y            by the user
///     menu ID ITEM             an item was chosen
///     focus ID                 has the keyboard now; "-" for none
///     window L,T,SCALE,TITLE   a modal window's content lies there on the screen, in view units
///     place ID L,T,R,B         what can be seen of a view, in view units of its window; again when it has changed
///     help TEXT
///     answer ID, file PATH, drop PATH, timer ended, primes COUNT, ended ID
class messageLog
{
public:
    explicit messageLog(bool isOn) : on(isOn) {}

    bool IsOn() const { return on; }
    void Write(std::string_view what, std::string_view about, std::string_view more = {}) const;
    void Value(const Sarnik::CValueMessage &message) const;

private:
    bool on;
};

} // namespace Stillmark
