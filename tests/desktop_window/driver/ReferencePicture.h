#pragma once

#include <QImage>
#include <QString>

namespace quarn::test {

/// How much two pictures of one size differ.
struct PictureDifference {
    double mean = 1.0;          ///< 0 for the same, 1 for black and white
    double differing_share = 1; ///< of the pixels, by more than a tenth in a channel
};

PictureDifference differenceOf(const QImage& a, const QImage& b);

/// Whether a picture shows what the reference of that name does: windows, controls and models in
/// their places. Both are looked at from some way off, so that letters may be drawn a little
/// otherwise. Where the environment has QUARN_WRITE_PICTURES the reference is written anew.
/// @return empty when it does; else by how much they differ
std::string compareWithReference(const QImage& picture, const QString& name);

} // namespace quarn::test
