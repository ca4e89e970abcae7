#pragma once
struct S { void F(); };
