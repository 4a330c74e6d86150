#pragma once

class TourHand;

/// Follows docs/GUIDE.md step by step in an empty window, with the names and numbers given there, and takes its
/// pictures. Saves and loads nothing; the panel gives it a statement of a bank.
void tourGuide(TourHand& hand);

/// What keeps work from being lost: a portfolio without its market file, and a Reinit. The panels give the sample.
void tourSafety(TourHand& hand);
/// Enters something and does not save it; and what the next window says of it.
void leaveUnsaved(TourHand& hand);
void tourRescue(TourHand& hand);
