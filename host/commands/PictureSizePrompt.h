#pragma once

#include "sdk/qncore/QnCommand.h"

namespace quarn {

/// Asks for the width and the height of a picture, each from 1 to ViewState::largest_side_px.
/// @param width_px, height_px  the defaults; receive the answers, also those given before a prompt
///                             was cancelled
CQuarnCommand::result askPictureSize(int& width_px, int& height_px);

} // namespace quarn
