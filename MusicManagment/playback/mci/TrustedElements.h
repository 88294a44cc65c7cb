#pragma once

using GstElement = struct _GstElement;

// Keeps a player ("playbin") to the parts that the types of this engine need. GStreamer itself goes by a
// file's contents and would follow a list that is called .mp3 to whatever address stands in it.
void KeepToTrustedElements(GstElement* player);
