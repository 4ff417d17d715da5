// Empty: the headers that most tests include are precompiled with this file.
