#!/usr/bin/env bash
# Builds the Debian package with the README's command, checks its metadata and
# files, unpacks it into a scratch root (dpkg -x) and runs the packaged
# kavu-cli on the example field book.
# Installs what is missing (Debian 12) with apt-get first.
set -euo pipefail
cd "$(dirname "$0")/.."

. tools/ensure-packages.sh
ensure_packages cmake ninja-build g++ libcli11-dev qt6-base-dev qt6-svg-dev dpkg-dev file \
  desktop-file-utils appstream shared-mime-info libglib2.0-bin

export CMAKE_GENERATOR=Ninja
rm -f build/package/kavu_*.deb
cmake --workflow --preset package
debs=(build/package/kavu_*.deb)
deb=${debs[0]}
echo "Package: $deb, $(stat -c %s "$deb") bytes"

failed=0
fail() {
  echo "FAIL: $*"
  failed=1
}

dpkg-deb -f "$deb" Package Version Maintainer Depends Description
depends=$(dpkg-deb -f "$deb" Depends)
for needed in libqt6widgets6 libqt6svg6 libstdc++6 qt6-qpa-plugins; do
  [[ $depends == *"$needed"* ]] || fail "Depends lacks $needed: $depends"
done
[[ $(dpkg-deb -f "$deb" Maintainer) == *"@example.org>" ]] || fail "Maintainer field"

root=build/package-root
rm -rf "$root"
dpkg -x "$deb" "$root"
for file in usr/bin/kavu usr/bin/kavu-cli usr/share/kavu/kavu.hlp \
  usr/share/applications/org.example.kavu.desktop usr/share/metainfo/org.example.kavu.metainfo.xml \
  usr/share/mime/packages/kavu.xml usr/share/icons/hicolor/scalable/apps/kavu.svg \
  usr/share/man/man1/kavu-cli.1.gz usr/share/doc/kavu/copyright; do
  [ -f "$root/$file" ] || fail "missing /$file"
done
desktop-file-validate "$root/usr/share/applications/org.example.kavu.desktop" || fail "desktop entry"
appstreamcli validate --no-net "$root/usr/share/metainfo/org.example.kavu.metainfo.xml" ||
  fail "AppStream metadata"
if [ -n "$(MANWIDTH=80 man --warnings -l "$root/usr/share/man/man1/kavu-cli.1.gz" 2>&1 >/dev/null)" ]; then
  fail "the manual page has warnings"
fi

# The file types, with the system's own: a field book is known by its first
# record among the other *.asc files.
mime=build/package-mime
rm -rf "$mime"
mkdir -p "$mime/mime/packages" "$mime/files"
cp /usr/share/mime/packages/freedesktop.org.xml "$root/usr/share/mime/packages/kavu.xml" \
  "$mime/mime/packages/"
update-mime-database "$mime/mime" 2>/dev/null
cp examples/job1.asc examples/instruments/job-{sdr.sdr,obs.obs,set.set,idx.idx,tcm.tcm} "$mime/files/"
printf -- '-----BEGIN PGP SIGNATURE-----\n' >"$mime/files/signature.asc"
printf 'a note\n' >"$mime/files/note.asc"
while read -r file type; do
  got=$(XDG_DATA_HOME="$PWD/$mime" XDG_DATA_DIRS="$PWD/$mime" \
    gio info -a standard::content-type "$mime/files/$file" | sed -n 's/.*content-type: //p')
  [ "$got" = "$type" ] || fail "$file is $got, not $type"
done <<'TYPES'
job1.asc application/x-kavu-fieldbook
job-sdr.sdr application/x-kavu-sdr
job-obs.obs application/x-kavu-obs
job-set.set application/x-kavu-set
job-idx.idx application/x-kavu-idx
job-tcm.tcm application/x-kavu-tcm
signature.asc application/pgp-signature
note.asc text/plain
TYPES

# The packaged batch command on a copy of the example: every product, no
# data error.
run=build/package-run
rm -rf "$run"
mkdir -p "$run/job"
cp examples/job1.asc "$run/job/"
status=0
"$root/usr/bin/kavu-cli" --all --seed 1 "$run/job/job1.asc" >"$run/stdout" || status=$?
[ "$status" -eq 0 ] || fail "kavu-cli ended with $status"
grep -q '^Tổng số điểm chi tiết:  110$' "$run/stdout" || fail "summary: $(cat "$run/stdout")"
for product in job/job1.txt job/job1.kc job/job1.td1 job/job1.dxf job/job1.sdo job/job1.cp TRIDO/job1.asc; do
  [ -s "$run/$product" ] || fail "no product $product"
done

[ "$failed" -eq 0 ] && echo "Package test passed"
exit "$failed"
