#ifndef UTIL_INTERNAL_H
#define UTIL_INTERNAL_H

/** Marks names outside the plug-in's interface; all others can be linked and replaced. */
#define MI_INTERNAL [[gnu::visibility("hidden")]]

#endif
