#pragma once

namespace quarn {

/// How far the even time of the planets' motions is ahead of the time by the earth's rotation:
/// terrestrial time minus universal time (delta T).
///
/// From Fred Espenak and Jean Meeus, Five Millennium Canon of Solar Eclipses (NASA/TP-2006-214141),
/// section 2.6, "Polynomial expressions for delta T". Beyond the book's own time it is a
/// prediction; an error of 25 seconds moves the sun by one arc-second.
///
/// @param year  with its fraction, from 1800 to 2200; outside of it the nearest expression is used
/// @return seconds
double earthRotationDelay_s(double year);

} // namespace quarn
