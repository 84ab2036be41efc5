#!/bin/sh
# Writes the files of the sample disc that are not plain copies, byte for byte the same on
# every run. printf writes the binary parts because CMake cannot write a NUL byte.
#   make_disc_file.sh utf16 SOURCE OUT   UTF-8 text as UTF-16LE with a byte-order mark and
#                                        CRLF line ends, so Notepad shows every script
#   make_disc_file.sh iff OUT            Setup\Tolven8.iff: an IFF container naming the disc
#   make_disc_file.sh cab OUT            Setup\data2.cab: a cabinet holding one stored file
#   make_disc_file.sh mpeg TITLE OUT     a demo: an MPEG-1 program stream without pictures
set -eu

byte() { printf "\\$(printf '%03o' "$(($1 & 255))")"; }
le16() { byte "$1"; byte "$(($1 >> 8))"; }
le32() { le16 "$(($1 & 65535))"; le16 "$((($1 >> 16) & 65535))"; }
be16() { byte "$(($1 >> 8))"; byte "$1"; }
be32() { be16 "$((($1 >> 16) & 65535))"; be16 "$(($1 & 65535))"; }

# An IFF chunk: id, big-endian length, data, padded to an even length.
chunk() {
    printf '%s' "$1"
    be32 "${#2}"
    printf '%s' "$2"
    if [ $((${#2} % 2)) -eq 1 ]; then byte 0; fi
}

padded_length() { echo $(((${#1} + 1) / 2 * 2)); }

write_iff() {
    name='The Vemo Vodizuri Virezazida'
    disc='Disc 1 of 1'
    version='1.0'
    size=$((4 + 8 + $(padded_length "$name") + 8 + $(padded_length "$disc") + 8 + $(padded_length "$version")))
    printf 'FORM'
    be32 "$size"
    printf 'VEMO'
    chunk NAME "$name"
    chunk DISC "$disc"
    chunk VERS "$version"
}

# One folder, one file, stored without compression and without checksums (a zero checksum
# means "none" in the cabinet format).
write_cab() {
    file='vemo2.txt'
    data='Second data cabinet of The Vemo Vodizuri Virezazida.
'
    files_at=44                                     # header (36) + one folder entry (8)
    data_at=$((files_at + 16 + ${#file} + 1))
    total=$((data_at + 8 + ${#data}))
    printf 'MSCF'; le32 0; le32 "$total"; le32 0; le32 "$files_at"; le32 0
    byte 3; byte 1                                  # format version 1.3
    le16 1; le16 1; le16 0; le16 0x5645; le16 0     # folders, files, flags, set id, index
    le32 "$data_at"; le16 1; le16 0                 # the folder: data block, stored
    le32 "${#data}"; le32 0; le16 0                 # the file: size, offset, folder
    le16 $(((2001 - 1980) << 9 | 10 << 5 | 1))      # 1 October 2001
    le16 $((12 << 11))                              # 12:00:00
    le16 0x20                                       # archive attribute
    printf '%s' "$file"; byte 0
    le32 0; le16 "${#data}"; le16 "${#data}"        # the data block
    printf '%s' "$data"
}

# A pack header and system header, the title in a private stream, and the end code: a
# stream players accept, with nothing to show.
write_mpeg() {
    printf '\000\000\001\272'; byte 0x21; be16 1; be16 1; byte 0x80; be16 0x0015
    printf '\000\000\001\273'; be16 6; byte 0x80; be16 0x0015; byte 0; byte 0xE0; byte 0xFF
    printf '\000\000\001\277'; be16 "${#1}"; printf '%s' "$1"
    printf '\000\000\001\271'
}

case "$1" in
    utf16)
        { printf '\377\376'; tr -d '\r' <"$2" | sed 's/$/\r/' | iconv -f UTF-8 -t UTF-16LE; } >"$3.part"
        mv "$3.part" "$3"
        ;;
    iff) write_iff >"$2" ;;
    cab) write_cab >"$2" ;;
    mpeg) write_mpeg "$2" >"$3" ;;
    *)
        echo "usage: $0 utf16 SOURCE OUT | iff OUT | cab OUT | mpeg TITLE OUT" >&2
        exit 2
        ;;
esac
