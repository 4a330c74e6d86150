#pragma once

class TourHand;

/// Follows docs/GUIDE.md step by step in an empty window, with the names and numbers given there, and takes its
/// pictures. Saves and loads nothing.
void tourGuide(TourHand& hand);
