// What became of an abbreviation, in words for the user. Pure; of the main thread, as all translations are.
#pragma once

#include <QCoreApplication>
#include <QString>

#include "engine/MatchDecision.h"

namespace plume {

// Very long names are cut.
struct DecisionWords {
    QString abbreviation;
    QString group;
    QString reason;    // short, for a list
    QString sentence;  // which tells all of it
    QString advice;    // what the user can do about it; empty when there is nothing

    static DecisionWords of(const MatchDecision& decision);

    Q_DECLARE_TR_FUNCTIONS(DecisionWords)
    static QString reasonOf(const MatchDecision& decision);
    static QString missingBefore(const MatchDecision& decision);
    static QString adviceOf(MatchDecision::Outcome outcome);
    QString sentenceOf(const MatchDecision& decision) const;
};

}  // namespace plume
