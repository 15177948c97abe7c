#ifndef MIHOST_CLI_SYSTEM_COLOURS_H
#define MIHOST_CLI_SYSTEM_COLOURS_H

namespace mihost
{

/** When text is coloured. Auto: at a terminal, unless NO_COLOR or TERM=dumb forbids it. */
enum class Colours { Auto, Always, Never };

/** Whether the cursor may be moved on the descriptor's terminal. */
bool takesControls(int descriptor);

bool takesColours(int descriptor, Colours colours);

} // namespace mihost

#endif
