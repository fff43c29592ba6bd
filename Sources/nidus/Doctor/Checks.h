#pragma once

#include "nidus/Doctor/Examination.h"
#include "nidus/Doctor/Finding.h"

namespace nidus {

/// The doctor's checks, one for each area and each in a unit of its own. Each appends what it has
/// found; a new one is declared here and listed in Doctor.cpp.

/// The data folder and its files: the owner, and who may read and write.
void checkDataFolder(const Examination& examination, Findings& findings);
/// The database file: pages, references, version.
void checkDatabase(const Examination& examination, Findings& findings);
/// The plug-in's module: found, and of this version.
void checkModule(const Examination& examination, Findings& findings);
/// The user's own words, and whether the words in use make sense to the plug-in.
void checkVocabulary(const Examination& examination, Findings& findings);
/// The preferences: known keys, and values of their types.
void checkPreferences(const Examination& examination, Findings& findings);
/// The homes as a whole: that there are some, that the assistant sees them, the primary one.
void checkHomes(const Examination& examination, Findings& findings);

// What follows looks at the homes, which there must be.

/// Names that mean several objects, for those orders that cannot tell them apart.
void checkNames(const Examination& examination, Findings& findings);
/// Services that the assistant cannot address, or not in every way.
void checkAddresses(const Examination& examination, Findings& findings);
/// Characteristics whose metadata contradict their values, themselves or the vocabulary.
void checkMetadata(const Examination& examination, Findings& findings);
/// Zones without rooms, zones that take each other's rooms, rooms without accessories.
void checkRooms(const Examination& examination, Findings& findings);
/// Groups and scenes that lead to nothing.
void checkTargets(const Examination& examination, Findings& findings);
/// Accessories that cannot be reached.
void checkAccessories(const Examination& examination, Findings& findings);

}  // namespace nidus
