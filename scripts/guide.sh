#!/usr/bin/env bash
# Looks the user's guide over: valid HTML, no link or picture that leads nowhere or out of the guide,
# no picture unused, and the same sections and pictures in both languages.
set -eu
cd "$(dirname "$0")/../guide"

failed=0
fault() { echo "$*"; failed=1; }
values() { grep -oE "\b$1=\"[^\"]*\"" "$2" | sed 's/^[^"]*"//; s/"$//'; } # ATTRIBUTE FILE

for page in en/index.html nl/index.html; do
    tidy -errors -quiet -utf8 --warn-proprietary-attributes no "$page" || fault "$page: see above"
    for target in $(values href "$page") $(values src "$page"); do
        case $target in
        *:*) fault "$page: $target leads out of the guide" ;;
        \#*) values id "$page" | grep -qx -- "${target#\#}" || fault "$page: nothing has the id $target" ;;
        *) [ -f "$(dirname "$page")/$target" ] || fault "$page: there is no $target" ;;
        esac
    done
    values id "$page" | sort | uniq -d | sed "s|^|$page: twice the id |" | grep . && failed=1
    for picture in "images/${page%%/*}"/*.png; do
        grep -q "src=\"../$picture\"" "$page" || fault "$page: $picture is shown nowhere"
    done
done
diff <(values id en/index.html) <(values id nl/index.html) || fault "the languages differ in their sections"
diff <(values src en/index.html) <(values src nl/index.html | sed 's|images/nl/|images/en/|') ||
    fault "the languages differ in their pictures"
exit $failed
