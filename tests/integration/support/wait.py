"""Waiting for what another process does."""

import time

LIMIT = 120  # seconds


def until(condition, what, retry=()):
    """Waits until the condition is true and returns it; the exceptions in retry mean that it is not.

    Raises TimeoutError with the text, or what the function of that name returns, at the limit.
    """
    deadline = time.monotonic() + LIMIT
    while True:
        try:
            result = condition()
        except retry:
            result = None
        if result:
            return result
        if time.monotonic() > deadline:
            raise TimeoutError(what() if callable(what) else what)
        time.sleep(0.05)
