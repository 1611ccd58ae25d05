"""Lists an inbox folder, a line a message, through the component: python inbox.py [FOLDER]

Needs the package pywin32. The package varnex3 reaches the same records without the component: see ../python.
"""

import sys

import win32com.client.gencache


def main(folder):
    messages = win32com.client.gencache.EnsureDispatch("Varnex3.Xalo_Messages")
    is_whole, number, words = messages.ParseFiles(folder, 0, "")  # what is by reference comes back with the result
    for i in range(messages.Count):
        message = messages.MessageItems(i)
        if message.ParseError:
            print(message.ErrorMessage)
        else:
            print(message.MessageNo, message.MessageDescription, message.Registration, message.ClaimNo, sep=", ")
    print(messages.Count, "messages")
    if not is_whole:
        print(f"Error {number}: {words}")


main(sys.argv[1] if len(sys.argv) > 1 else r"samples\inbox")
