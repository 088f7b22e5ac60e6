struct Unguarded {};
