#!/bin/sh
# The desktop program under a virtual X server: computes the example field
# book with the products ticked in its settings, saves pictures of the main
# window and of the summary into the build folder, and checks that the
# products are those of the batch command.
# Usage: smoke.sh KAVU KAVU-CLI FIELD-BOOK BUILD-FOLDER
set -eu
kavu=$1 cli=$2 book=$3 build=$4
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
mkdir -p "$work/gui/data" "$work/cli/data" "$work/config/KAVU"
cp "$book" "$work/gui/data/job1.asc"
cp "$book" "$work/cli/data/job1.asc"
# A store of its own, with every product that the settings keep ticked.
printf '[Settings]\nKAVU_TyleTXT=1000\nKAVU_Fkc=1\nKAVU_Fasc=1\nKAVU_Ftd=1\nKAVU_Fcp=1\nKAVU_Fdc=1\n' \
  > "$work/config/KAVU/KAVU.ini"
XDG_CONFIG_HOME="$work/config" HOME="$work" \
  "$kavu" --compute "$work/gui/data/job1.asc" --screenshot "$build/kavu-main.png"
"$cli" "$work/cli/data/job1.asc" --scale 1000 --kc --asc --txt --pegs --heights >/dev/null || true
test -s "$build/kavu-main.png" && test -s "$build/kavu-main-summary.png"
for product in data/job1.txt data/job1.kc data/job1.cp data/job1.td1 TRIDO/job1.asc; do
  cmp "$work/gui/$product" "$work/cli/$product"
done
# The settings store is left as it was.
grep -q '^KAVU_Fkc=1$' "$work/config/KAVU/KAVU.ini"
