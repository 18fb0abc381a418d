import datetime
print("it's", datetime.date.today())
