#!/bin/sh
# Makes a Windows Media file of a WAV file with ffmpeg. Tunestead starts it with the names of both and the bit rate in
# kbit/s; a copy with other options can be named in the settings. It must write the file that it was told, answer with 0
# when that is whole, and may print its reasons when it is not.
exec ffmpeg -nostdin -hide_banner -loglevel error -y -f wav -i "file:$1" -map_metadata -1 \
    -c:a wmav2 -b:a "${3}k" -f asf "file:$2"
