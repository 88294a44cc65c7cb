#!/bin/sh
# Makes a Windows Media file of a WAV file with ffmpeg. Tunestead starts it with the names of both and the bit rate in
# kbit/s; a copy with other options can be named in the settings. It must write the file that it was told, answer with 0
# when that is whole, and may print its reasons when it is not.

# Decoders leave out a frame more than this encoder puts in front, and so the beginning of the song. A frame of silence
# stands there instead; how long one is follows from the sample rate, which the head of the WAV file has in byte 24.
rate=$(od -An -tu4 -j24 -N4 "$1" | tr -d ' ')
if [ "$rate" -le 16000 ]; then frame=512; elif [ "$rate" -le 22050 ]; then frame=1024; else frame=2048; fi

exec ffmpeg -nostdin -hide_banner -loglevel error -y -f wav -i "file:$1" -map_metadata -1 -af "adelay=${frame}S:all=1" \
    -c:a wmav2 -b:a "${3}k" -f asf "file:$2"
