#ifndef TESTS_MIHOST_CLI_INPUT_RIGHTVALUE_H
#define TESTS_MIHOST_CLI_INPUT_RIGHTVALUE_H

#include "mihost/cli/catalogue/Catalogue.h"

#include <string>

/** @return a value of the form that is accepted */
inline std::string rightValue(mihost::Form form)
{
    switch (form) {
    case mihost::Form::Digits:
        return "7";
    case mihost::Form::Path:
        return "/home/jdoe";
    case mihost::Form::Day:
        return "2030-12-31";
    default:
        return "jdoe";
    }
}

#endif
