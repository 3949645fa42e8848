// File names against patterns with '*' and '?'. Texts are code page 1250.
#pragma once

// Matches a whole name as a Windows file search does, on every system: '*' is any run of characters, but one right
// before a dot does not run past the name's last dot; '?' is one character but a dot, or none at a dot or the end; a
// dot right before a wildcard may also stand for the end. So "*.*" matches every name and "*.???" those with an
// extension of up to three characters or none. A pattern that ends in a dot matches only names without one. Letters
// match without regard to case, those with accents too. Short (8.3) names are not looked at.
bool bMatchesPattern(const char* szName, const char* szPattern);
