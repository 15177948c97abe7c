#ifndef TESTS_SUPPORT_STREAMS_H
#define TESTS_SUPPORT_STREAMS_H

#include <cstdio>
#include <string>

/** The text as a stream; unlike an in-memory stream it holds NUL bytes and emptiness well. */
FILE* streamOf(std::string const& text);

#endif
