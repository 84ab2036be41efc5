#!/usr/bin/env bash
# Prints the build Wine runs here: i686 (the shipped one) where 32-bit Wine is present,
# else x86_64.
if dpkg-query -W -f='${Status}' wine32:i386 2>/dev/null | grep -q "install ok installed"; then
    echo i686
else
    echo x86_64
fi
