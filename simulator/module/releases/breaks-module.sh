#!/bin/sh
# Install script of a faulty Vexa module release: it flashes nothing usable,
# and the module comes back from its restart without a version file.
rm -f /root/App/AppExe/version.txt
: >/run/vexa/restart-request
echo "Vexa module software installed; the module restarts"
