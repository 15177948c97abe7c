#!/bin/sh
# Writes po/mihost.pot, the texts to translate, with GNU gettext.
set -eu
cd "$(dirname "$0")"
find src -name '*.js' | LC_ALL=C sort |
    xgettext --language=JavaScript --from-code=UTF-8 --keyword=_ --add-location=file --package-name=mihost \
        --files-from=- --output=- |
    sed '/^# /d; /^#$/d; /^#, fuzzy$/d; /^"POT-Creation-Date:/d' >po/mihost.pot
