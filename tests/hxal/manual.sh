#!/usr/bin/env bash
# Runs the indented lines of hxal/README.md, which compile, link and start a client, on c_client.c: manual.sh SOURCES BUILD FOLDER
set -euo pipefail
cd "$1"
commands=$(sed -n 's/^    //p' hxal/README.md |
  sed "s|client\.c|tests/hxal/c_client.c|; s|build/dev|$2|g; s|-o client|-o $3/manual_client|; s|\./client|$3/manual_client|; s|=cna |=tests/hxal/c_client.json |")
[ "$(wc -l <<< "$commands")" = 2 ]
set -x
eval "${commands//$'\n'/ && }"
