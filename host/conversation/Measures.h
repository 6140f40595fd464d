#pragma once

/// The measures of a conversation, points. "Start" and "end" follow the reading direction.
namespace ktr::host::measures {

inline constexpr double kWideFrom = 900.0;  ///< from this width on, question and answer stand side by side

// Everywhere
inline constexpr double kCardCorner = 20.0;
inline constexpr double kBubbleCorner = 20.0;
inline constexpr double kBubbleTailCorner = 6.0;  ///< the bottom end corner
inline constexpr double kBubbleTop = 10.0;
inline constexpr double kBubbleSide = 16.0;
inline constexpr double kBubbleBottom = 11.0;
inline constexpr double kQuestionToSentence = 14.0;
inline constexpr double kCardToQuestion = 22.0;
inline constexpr double kCardToStreets = 2.0;  ///< to the line that says that there are none
inline constexpr double kRingToBubble = 12.0;  ///< while the question waits for its answer
inline constexpr double kMark = 16.0;          ///< in the ring's place, where nothing came
inline constexpr double kSentenceToOffers = 12.0;
inline constexpr double kSentenceToQuestions = 18.0;
inline constexpr double kOffersToQuestion = 6.0;  ///< besides what is between a card and the next question

// A card's header; x from the card's start edge
inline constexpr double kHeaderHeight = 48.0;
inline constexpr double kHeaderIcon = 28.0;
inline constexpr double kHeaderIconTop = 11.0;  ///< a point below the middle: on the title's x-height, not its line box
inline constexpr double kLargeHeaderHeight = 76.0;  ///< with very large text
inline constexpr double kLargeHeaderIcon = 40.0;
inline constexpr double kLargeHeaderIconTop = 18.0;
inline constexpr double kAxisAvatar = 42.0;
inline constexpr double kAxisText = 82.0;
inline constexpr double kCardInset = 15.0;
inline constexpr double kRing = 18.0;
inline constexpr double kRingToEnd = 18.0;
inline constexpr double kRingStroke = 2.2;

// Rows
inline constexpr double kFocusInset = 3.0;
inline constexpr double kFocusCorner = 17.0;

// Phone
inline constexpr double kGutter = 12.0;
inline constexpr double kTimeAbove = 16.0;
inline constexpr double kTimeBelow = 12.0;
inline constexpr double kCornerToTurn = 8.0;  ///< from what a host puts over the top end corner
inline constexpr double kBubbleShare = 0.76;  ///< of the window's width
inline constexpr double kSentenceStart = 27.0;
inline constexpr double kSentenceToCard = 10.0;
inline constexpr double kPhoneBottom = 24.0;  ///< under the last card: room for its shadow

// Wide
inline constexpr double kMargin = 40.0;
inline constexpr double kSpeechColumn = 316.0;
inline constexpr double kColumnGap = 24.0;
inline constexpr double kWideCard = 680.0;
inline constexpr double kSpeechInset = 3.0;  ///< of sentence and time from the column's end, under the bubble's curve
inline constexpr double kSentenceToTime = 8.0;
inline constexpr double kWideTop = 24.0;
inline constexpr double kWideBottom = 40.0;

}  // namespace ktr::host::measures
