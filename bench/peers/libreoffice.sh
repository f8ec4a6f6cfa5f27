#!/bin/sh
# Loads the workbook and writes its first worksheet as text: there is no way to load it alone.
out=$(mktemp -d)
soffice --headless "-env:UserInstallation=file://$out/profile" --convert-to csv --outdir "$out" "$1"
result=$?
rm -rf "$out"
exit $result
