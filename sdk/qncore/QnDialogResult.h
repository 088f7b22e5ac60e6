#pragma once

/// How a modal dialog ended, as DoModal and its like return it.
enum QnDialogResult : int {
    QnDialogNotShown = -1, ///< it could not be shown; a message said why
    QnDialogConfirmed = 1, ///< the person took what is in it
    QnDialogGivenUp = 2,   ///< the person closed it otherwise, or there is nobody
};
