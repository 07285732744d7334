// Carries the precompiled headers that all rooms share; has nothing of its own.
