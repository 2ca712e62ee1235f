INSERT INTO my table (title,body'text') VALUES ("Spring ""Garden"" Tips & Tricks ","Plant early.
Water <often> & well ]]> done. ");
INSERT INTO my table (title,body'text') VALUES ("Spring Garden Tip 2 & More","Plant ""early"" 2.
Water <often> & well. ");
INSERT INTO my table (title,body'text') VALUES ("Spring Garden Tip 3 & More","Plant ""early"" 3.
Water <often> & well. ");
INSERT INTO my table (title,body'text') VALUES ("Spring Garden Tip 4 & More","Plant ""early"" 4.
Water <often> & well. ");
