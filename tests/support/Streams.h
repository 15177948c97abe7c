#ifndef TESTS_SUPPORT_STREAMS_H
#define TESTS_SUPPORT_STREAMS_H

#include <cstdio>
#include <string>

/** @return the text as a stream; unlike fmemopen, this also works with NUL bytes and no text */
FILE* streamOf(std::string const& text);

#endif
