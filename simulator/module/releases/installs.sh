#!/bin/sh
# Install script of a Vexa module release: unpacks the release over the
# module's file system, then asks the module's power controller for the
# restart that starts the new software.
set -e
unzip -o -q /root/OSUpgrade.zip -d /
sync
: >/run/vexa/restart-request
echo "Vexa module software installed; the module restarts"
