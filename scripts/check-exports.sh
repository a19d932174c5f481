#!/usr/bin/env bash
# Fails when the plug-in exports a symbol of ours other than Qvz_MGTWizMain's.
set -euo pipefail
lib=${1:?usage: check-exports.sh LIBRARY}
exports=$(nm -DC --defined-only "$lib" | awk '{ $1=""; $2=""; sub(/^  /, ""); print }')
ours=$(echo "$exports" | grep -E 'Qvz_|Wg_|Port::|UT_STR' || true)
bad=$(echo "$ours" | grep -vE '^(typeinfo (name )?for |vtable for )?Qvz_MGTWizMain(::|$)' | grep -v '^$' || true)
if [ -n "$bad" ]; then
  echo "check-exports: $lib exports more than Qvz_MGTWizMain:" >&2
  echo "$bad" >&2
  exit 1
fi
if ! echo "$ours" | grep -q 'Qvz_MGTWizMain::Qvz_MGTWizMain'; then
  echo "check-exports: $lib does not export Qvz_MGTWizMain" >&2
  exit 1
fi
echo "check-exports: only Qvz_MGTWizMain is exported"
