// Carries the precompiled headers that all test programs share; has nothing of its own.
