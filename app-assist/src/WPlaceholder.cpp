// Removed once the framework's first source file lands.
