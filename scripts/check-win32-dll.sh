#!/bin/sh
# Checks the cross-built modules in BIN: kxvfix.dll exports exactly its two entry points by
# their decorated standard-call names, and no module imports a DLL other than Windows' own
# and the host libraries kxutil.dll and kxapi.dll (the compiler's runtime is linked in).
set -eu
bin=$1
objdump=i686-w64-mingw32-objdump
status=0

exports=$($objdump -p "$bin/kxvfix.dll" |
  sed -n '/^\[Ordinal\/Name Pointer\] Table/,/^$/s/^[[:space:]]*\[ *[0-9]*\] //p' | sort | xargs)
echo "kxvfix.dll exports: $exports"
if [ "$exports" != "_DeleteValidator@4 _NewValidator@0" ]; then
  echo "kxvfix.dll must export exactly _NewValidator@0 and _DeleteValidator@4" >&2
  status=1
fi

for module in kxvfix.dll kxutil.dll kxapi.dll kxvalidate.exe; do
  imports=$($objdump -p "$bin/$module" | sed -n 's/^[[:space:]]*DLL Name: //p' | xargs)
  echo "$module imports: $imports"
  for dll in $imports; do
    case $(echo "$dll" | tr 'A-Z' 'a-z') in
      kernel32.dll | msvcrt.dll | advapi32.dll | kxutil.dll | kxapi.dll) ;;
      *)
        echo "$module must not import $dll" >&2
        status=1
        ;;
    esac
  done
done
exit $status
