#ifndef UTIL_INTERNAL_H
#define UTIL_INTERNAL_H

/** Marks what is no part of the plug-in's interface: everything else can be linked and replaced. */
#define MI_INTERNAL [[gnu::visibility("hidden")]]

#endif
